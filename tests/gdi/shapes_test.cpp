// Lines, rectangles and single pixels.
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

namespace {

struct LineCase {
    POINT from, to;
    Rows expected;
};

void drawLine(HDC dc, POINT from, POINT to, COLORREF colour) {
    HPEN pen = CreatePen(PS_SOLID, 1, colour);
    const HGDIOBJ before = SelectObject(dc, pen);
    MoveToEx(dc, from.x, from.y, nullptr);
    EXPECT_TRUE(LineTo(dc, to.x, to.y));
    SelectObject(dc, before);
    DeleteObject(pen);
}

} // namespace

TEST(Line, LeavesOutItsEndPoint) {
    const LineCase cases[] = {
        {{0, 1}, {3, 1}, {".....", "RRR..", ".....", "....."}},
        {{3, 1}, {0, 1}, {".....", ".RRR.", ".....", "....."}},
        {{2, 0}, {2, 3}, {"..R..", "..R..", "..R..", "....."}},
        {{2, 3}, {2, 0}, {".....", "..R..", "..R..", "..R.."}},
        {{0, 0}, {3, 3}, {"R....", ".R...", "..R..", "....."}},
        {{4, 3}, {1, 0}, {".....", "..R..", "...R.", "....R"}},
        {{0, 3}, {3, 0}, {".....", "..R..", ".R...", "R...."}},
        {{0, 0}, {4, 2}, {"R....", ".RR..", "...R.", "....."}},
        {{1, 1}, {1, 1}, {".....", ".....", ".....", "....."}},
        {{-3, 2}, {2, 2}, {".....", ".....", "RR...", "....."}},
        {{-9, 2}, {99, 2}, {".....", ".....", "RRRRR", "....."}},
        {{3, 99}, {3, -9}, {"...R.", "...R.", "...R.", "...R."}},
        {{0, -1}, {5, -1}, {".....", ".....", ".....", "....."}},
        {{5, 0}, {5, 4}, {".....", ".....", ".....", "....."}},
        {{-2147483647 - 1, 0}, {2147483647, 0}, {"RRRRR", ".....", ".....", "....."}},
        {{2147483647, 2147483647},
         {-2147483647 - 1, -2147483647 - 1},
         {"R....", ".R...", "..R..", "...R."}},
    };
    for (const LineCase& c : cases) {
        Memory memory(5, 4, false);
        drawLine(memory.dc, c.from, c.to, RGB(255, 0, 0));
        EXPECT_EQ(memory.text(), c.expected)
            << c.from.x << "," << c.from.y << " to " << c.to.x << "," << c.to.y;
    }
}

TEST(Line, GoesOnFromItsEndPoint) {
    Memory memory({"WWW", "WWW"});
    MoveToEx(memory.dc, 0, 0, nullptr);
    LineTo(memory.dc, 2, 0);
    LineTo(memory.dc, 2, 2);
    EXPECT_EQ(memory.text(), (Rows{"...", "WW."}));
    POINT position{};
    MoveToEx(memory.dc, 0, 0, &position);
    EXPECT_EQ(position.x, 2);
    EXPECT_EQ(position.y, 2);
    SelectObject(memory.dc, GetStockObject(NULL_PEN));
    LineTo(memory.dc, 0, 2);
    MoveToEx(memory.dc, 0, 0, &position);
    EXPECT_EQ(memory.text(), (Rows{"...", "WW."})) << "the null pen moves and draws nothing";
    EXPECT_EQ(position.y, 2);
}

TEST(Line, KeepsToTheClipOfAWindowAndTellsIt) {
    TestSurface surface({"WWWW", "WWWW"});
    HDC window = seam::makeSurfaceContext(surface, {1, 1, 3, 2});
    drawLine(window, {0, 1}, {4, 1}, RGB(255, 0, 0));
    drawLine(window, {0, 0}, {4, 0}, RGB(255, 0, 0));
    EXPECT_EQ(surface.text(), (Rows{"WWWW", "WRRW"}));
    EXPECT_EQ(surface.touched, (std::vector<RECT>{{1, 1, 3, 2}}));
    DeleteDC(window);
}

TEST(Pen, OnlyASolidOneOfOnePixelIsMade) {
    EXPECT_FALSE(CreatePen(1, 1, 0));
    EXPECT_FALSE(CreatePen(PS_SOLID, 2, 0));
}

TEST(Rectangle, OutlinesWithThePenAndFillsWithTheBrush) {
    Memory memory(6, 4, false);
    HBRUSH brush = CreateSolidBrush(RGB(0, 255, 0));
    HPEN pen = CreatePen(PS_SOLID, 1, RGB(255, 0, 0));
    SelectObject(memory.dc, brush);
    SelectObject(memory.dc, pen);
    EXPECT_TRUE(Rectangle(memory.dc, 1, 0, 5, 4));
    EXPECT_EQ(memory.text(), (Rows{".RRRR.", ".RGGR.", ".RGGR.", ".RRRR."}));
    EXPECT_TRUE(Rectangle(memory.dc, 3, 3, 3, 9));
    EXPECT_TRUE(Rectangle(memory.dc, 5, 3, 2, 1));
    EXPECT_EQ(memory.text()[2], ".RGGR.") << "no area, nothing drawn";
    SelectObject(memory.dc, GetStockObject(NULL_BRUSH));
    Rectangle(memory.dc, -3, -3, 4, 3);
    EXPECT_EQ(memory.text(), (Rows{".RRRR.", ".RGRR.", "RRRRR.", ".RRRR."}));
    SelectObject(memory.dc, GetStockObject(WHITE_BRUSH));
    SelectObject(memory.dc, GetStockObject(NULL_PEN));
    Rectangle(memory.dc, 4, 2, 6, 4);
    EXPECT_EQ(memory.text(), (Rows{".RRRR.", ".RGRR.", "RRRRWW", ".RRRWW"}));
    SelectObject(memory.dc, GetStockObject(BLACK_PEN));
    DeleteObject(brush);
    DeleteObject(pen);
}

TEST(FillRect, FillsWithinTheClip) {
    TestSurface surface({"....", "....", "...."});
    HDC window = seam::makeSurfaceContext(surface, {0, 0, 3, 9});
    const RECT area{1, 1, 99, 99};
    EXPECT_NE(FillRect(window, &area, HBRUSH{GetStockObject(LTGRAY_BRUSH)}), 0);
    EXPECT_EQ(surface.text(), (Rows{"....", ".cc.", ".cc."}));
    EXPECT_EQ(FillRect(window, &area, nullptr), 0);
    EXPECT_EQ(FillRect(window, nullptr, HBRUSH{GetStockObject(WHITE_BRUSH)}), 0);
    DeleteDC(window);
}

TEST(FillRect, OnAMonochromeBitmapTheBackgroundColourIsOne) {
    Memory mask(2, 1, true);
    const RECT left{0, 0, 1, 1};
    const RECT both{0, 0, 2, 1};
    FillRect(mask.dc, &both, HBRUSH{GetStockObject(WHITE_BRUSH)});
    EXPECT_EQ(mask.text(), Rows{"11"});
    FillRect(mask.dc, &left, HBRUSH{GetStockObject(LTGRAY_BRUSH)});
    EXPECT_EQ(mask.text(), Rows{"01"});
}

TEST(GetPixel, TellsTheColour) {
    Memory memory({"RB"});
    EXPECT_EQ(GetPixel(memory.dc, 0, 0), RGB(255, 0, 0));
    EXPECT_EQ(GetPixel(memory.dc, 1, 0), RGB(0, 0, 255));
    for (const POINT outside : {POINT{2, 0}, POINT{-1, 0}, POINT{0, 1}, POINT{0, -1}}) {
        EXPECT_EQ(GetPixel(memory.dc, outside.x, outside.y), CLR_INVALID);
    }
}

TEST(Rectangles, TestAndGrow) {
    const RECT area{2, 3, 5, 6};
    EXPECT_TRUE(PtInRect(&area, {2, 3}));
    EXPECT_TRUE(PtInRect(&area, {4, 5}));
    EXPECT_FALSE(PtInRect(&area, {5, 5}));
    EXPECT_FALSE(PtInRect(&area, {4, 6}));
    EXPECT_FALSE(PtInRect(&area, {1, 3}));
    EXPECT_FALSE(PtInRect(&area, {2, 2}));
    RECT grown = area;
    EXPECT_TRUE(InflateRect(&grown, 2, -1));
    EXPECT_EQ(grown, (RECT{0, 4, 7, 5}));
}

TEST(SystemColours, AreTheClassicOnes) {
    EXPECT_EQ(GetSysColor(COLOR_BTNFACE), RGB(192, 192, 192));
    EXPECT_EQ(GetSysColor(COLOR_BTNSHADOW), RGB(128, 128, 128));
    EXPECT_EQ(GetSysColor(COLOR_BTNHIGHLIGHT), RGB(255, 255, 255));
    EXPECT_EQ(GetSysColor(99), RGB(0, 0, 0));
}
