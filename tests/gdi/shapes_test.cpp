// Lines, rectangles and single pixels.
#include "tests/gdi/pictures.h"

#include <climits>
#include <gtest/gtest.h>

using namespace test;

namespace {

void drawLine(HDC dc, POINT from, POINT to) {
    SelectObject(dc, GetStockObject(WHITE_PEN));
    MoveToEx(dc, from.x, from.y, nullptr);
    EXPECT_TRUE(LineTo(dc, to.x, to.y));
}

} // namespace

TEST(Line, LeavesOutItsEndPoint) {
    const std::tuple<POINT, POINT, Rows> cases[] = {
        {{0, 1}, {3, 1}, {".....", "WWW..", ".....", "....."}},
        {{2, 3}, {2, 0}, {".....", "..W..", "..W..", "..W.."}},
        {{0, 3}, {3, 0}, {".....", "..W..", ".W...", "W...."}},
        {{0, 0}, {4, 2}, {"W....", ".WW..", "...W.", "....."}},
        {{1, 1}, {1, 1}, plain(5, 4, '.')},
        {{3, 99}, {3, -9}, {"...W.", "...W.", "...W.", "...W."}},
        {{5, 0}, {5, 4}, plain(5, 4, '.')},
        {{INT_MIN, 0}, {INT_MAX, 0}, {"WWWWW", ".....", ".....", "....."}},
    };
    for (const auto& [from, to, expected] : cases) {
        const Memory memory(plain(5, 4, '.'));
        drawLine(memory.dc, from, to);
        EXPECT_EQ(memory.text(), expected)
            << from.x << "," << from.y << " to " << to.x << "," << to.y;
    }
}

TEST(Line, GoesOnFromItsEndPoint) {
    const Memory memory({"WWW", "WWW"});
    MoveToEx(memory.dc, 0, 0, nullptr);
    LineTo(memory.dc, 2, 0);
    SelectObject(memory.dc, GetStockObject(NULL_PEN));
    LineTo(memory.dc, 0, 1);
    SelectObject(memory.dc, GetStockObject(BLACK_PEN));
    LineTo(memory.dc, 2, 1);
    EXPECT_EQ(memory.text(), (Rows{"..W", "..W"})) << "the null pen moves and draws nothing";
}

TEST(Shapes, KeepToTheClipOfAWindowAndTellIt) {
    TestSurface window(plain(4, 3, '.'), {1, 1, 3, 9});
    drawLine(window.dc, {0, 1}, {4, 1});
    drawLine(window.dc, {0, 0}, {4, 0});
    EXPECT_EQ(window.text(), (Rows{"....", ".WW.", "...."}));
    EXPECT_EQ(window.touched, (std::vector<RECT>{{1, 1, 3, 2}}));
    const RECT area{2, 0, 99, 99};
    EXPECT_NE(FillRect(window.dc, &area, HBRUSH{GetStockObject(LTGRAY_BRUSH)}), 0);
    EXPECT_EQ(window.text(), (Rows{"....", ".Wc.", "..c."}));
    EXPECT_EQ(window.touched.back(), (RECT{2, 1, 3, 3}));
}

TEST(Rectangle, OutlinesWithThePenAndFillsWithTheBrush) {
    const Memory memory(plain(6, 4, 'G'));
    EXPECT_TRUE(Rectangle(memory.dc, 1, 0, 5, 4));
    EXPECT_EQ(memory.text(), (Rows{"G....G", "G.WW.G", "G.WW.G", "G....G"}));
    EXPECT_TRUE(Rectangle(memory.dc, 3, 3, 3, 9));
    EXPECT_TRUE(Rectangle(memory.dc, 5, 3, 2, 1));
    EXPECT_EQ(memory.text()[2], "G.WW.G") << "no area, nothing drawn";
    SelectObject(memory.dc, GetStockObject(NULL_BRUSH));
    Rectangle(memory.dc, -3, -3, 4, 3);
    EXPECT_EQ(memory.text(), (Rows{"G....G", "G.W..G", ".....G", "G....G"}));
    SelectObject(memory.dc, GetStockObject(LTGRAY_BRUSH));
    SelectObject(memory.dc, GetStockObject(NULL_PEN));
    Rectangle(memory.dc, 4, 2, 6, 4);
    EXPECT_EQ(memory.text(), (Rows{"G....G", "G.W..G", "....cc", "G...cc"}));
}
