// Bevels, shadows and plain pictures. 'x' is the dark side, 'W' the light one.
#include "platform/drawing_kit.h"
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

namespace {

struct BevelCase {
    int width;
    Rows expected;
};

Rows blank(int width, int height) {
    return Rows(static_cast<std::size_t>(height),
                std::string(static_cast<std::size_t>(width), 'G'));
}

/// Where the text of each colour stands if it is drawn alone in the rectangle.
RECT inkOf(HFONT font, const char* text, RECT area) {
    Memory memory(blank(120, 60));
    const HGDIOBJ before = SelectObject(memory.dc, font);
    SetBkMode(memory.dc, TRANSPARENT);
    SetTextColor(memory.dc, RGB(255, 0, 0));
    DrawTextA(memory.dc, text, -1, &area, DT_CENTER);
    SelectObject(memory.dc, before);
    return boundsOf(memory.text(), 'R');
}

} // namespace

TEST(Bevel, OneEdgeLeavesOutTheCornerPixel) {
    Memory memory(blank(6, 5));
    HPEN first = CreatePen(PS_SOLID, 1, RGB(255, 0, 0));
    HPEN second = CreatePen(PS_SOLID, 1, RGB(0, 0, 255));
    DrawBevelEdge(memory.dc, 0, 0, 6, 5, first, second);
    EXPECT_EQ(memory.text(), (Rows{"RRRRRB", "RGGGGB", "RGGGGB", "RGGGGB", "RGBBBB"}));
    EXPECT_TRUE(DeleteObject(first)) << "nothing stays selected";
    EXPECT_TRUE(DeleteObject(second));
}

TEST(Bevel, DrawsRingsInwards) {
    const BevelCase cases[] = {
        {0, {"GGGGGGG", "GGGGGGG", "GGGGGGG", "GGGGGGG", "GGGGGGG", "GGGGGGG"}},
        {1, {"GGGGGGG", "GxxxxWG", "GxGGGWG", "GxGGGWG", "GxGWWWG", "GGGGGGG"}},
        {-1, {"GGGGGGG", "GWWWWxG", "GWGGGxG", "GWGGGxG", "GWGxxxG", "GGGGGGG"}},
    };
    for (const BevelCase& c : cases) {
        Memory memory(blank(7, 6));
        DrawBevel(memory.dc, 1, 1, 6, 5, c.width);
        EXPECT_EQ(memory.text(), c.expected) << c.width;
    }
}

TEST(Bevel, TwoRingsOnTenByTen) {
    Memory memory(blank(10, 10));
    const auto before = liveObjects();
    DrawBevel(memory.dc, 0, 0, 10, 10, 2);
    EXPECT_EQ(liveObjects(), before);
    EXPECT_EQ(memory.text(),
              (Rows{"xxxxxxxxxW", "xxxxxxxxWW", "xxGGGGGGWW", "xxGGGGGGWW", "xxGGGGGGWW",
                    "xxGGGGGGWW", "xxGGGGGGWW", "xxGGGGGGWW", "xxGWWWWWWW", "xGWWWWWWWW"}));
}

TEST(Bevel, TheBoxIsTheSameInsideForBothSigns) {
    for (const int width : {1, -1}) {
        Memory memory(blank(6, 5));
        SelectObject(memory.dc, GetStockObject(LTGRAY_BRUSH));
        EXPECT_TRUE(DrawBevelBox(memory.dc, 0, 0, 6, 5, width));
        const char first = width > 0 ? 'x' : 'W';
        const char second = width > 0 ? 'W' : 'x';
        Rows expected{"111112", "1....2", "1.cc.2", "1....2", "1G2222"};
        for (std::string& row : expected) {
            for (char& pixel : row) {
                pixel = pixel == '1' ? first : pixel == '2' ? second : pixel;
            }
        }
        EXPECT_EQ(memory.text(), expected) << width;
    }
}

TEST(ShadowText, LaysEachPassOnePixelOnAndHalfAsFarAside) {
    HFONT font = MakeFont(20, 400, "MS Serif");
    const RECT area{10, 10, 111, 60};
    const RECT plain = inkOf(font, "I", area);
    Memory memory(blank(120, 60));
    const HGDIOBJ before = SelectObject(memory.dc, font);
    SetBkMode(memory.dc, TRANSPARENT);
    DrawShadowPasses(memory.dc, "I", 2, area.left, area.top, area.right, area.bottom,
                     RGB(255, 0, 0), RGB(0, 0, 255));
    EXPECT_EQ(SetTextColor(memory.dc, 0), RGB(0, 0, 0)) << "the text colour is back";
    const Rows picture = memory.text();
    EXPECT_EQ(boundsOf(picture, 'R').top, plain.top - 2);
    EXPECT_EQ(boundsOf(picture, 'B').bottom, plain.bottom + 2);
    const RECT farUp = inkOf(font, "I", {area.left - 2, area.top - 2, area.right, area.bottom});
    const RECT farDown = inkOf(font, "I", {area.left + 2, area.top + 2, area.right, area.bottom});
    EXPECT_EQ(boundsOf(picture, 'R').left, farUp.left);
    EXPECT_EQ(boundsOf(picture, 'B').right, farDown.right);
    EXPECT_EQ(farUp.left, plain.left - 1);
    EXPECT_EQ(farDown.left, plain.left + 1);
    SelectObject(memory.dc, before);
    DeleteObject(font);
}

TEST(ShadowText, DepthAndItsNegativeExchangeTheColours) {
    HFONT font = MakeFont(20, 700, "MS Serif");
    const auto draw = [font](int depth) {
        Memory memory(blank(80, 40));
        const HGDIOBJ before = SelectObject(memory.dc, font);
        EXPECT_GT(DrawShadowText(memory.dc, RGB(255, 0, 0), "Mo", 0, 5, 80, 40, depth), 0);
        EXPECT_EQ(SetBkMode(memory.dc, OPAQUE), OPAQUE) << "the background mode is back";
        EXPECT_EQ(SetTextColor(memory.dc, 0), RGB(255, 0, 0)) << "the text colour stays";
        SelectObject(memory.dc, before);
        return memory.text();
    };
    Rows raised = draw(1);
    const Rows sunken = draw(-1);
    EXPECT_LT(boundsOf(raised, 'W').top, boundsOf(raised, 'x').top);
    EXPECT_NE(raised, sunken);
    EXPECT_EQ(boundsOf(raised, 'W').top, boundsOf(sunken, 'x').top);
    EXPECT_EQ(boundsOf(raised, 'x').bottom, boundsOf(sunken, 'W').bottom);
    EXPECT_EQ(boundsOf(raised, 'R'), boundsOf(sunken, 'R'));
    const Rows flat = draw(0);
    EXPECT_EQ(boundsOf(flat, 'W'), (RECT{0, 0, 0, 0}));
    EXPECT_EQ(boundsOf(flat, 'x'), (RECT{0, 0, 0, 0}));
    EXPECT_EQ(boundsOf(flat, 'R'), boundsOf(raised, 'R'));
    DeleteObject(font);
}

TEST(MakeFont, AsksForCharactersOfTheHeight) {
    HDC dc = CreateCompatibleDC(nullptr);
    HFONT font = MakeFont(32, 700, "MS Serif");
    const HGDIOBJ before = SelectObject(dc, font);
    TEXTMETRICA metrics{};
    EXPECT_TRUE(GetTextMetricsA(dc, &metrics));
    EXPECT_EQ(metrics.tmHeight - metrics.tmInternalLeading, 32);
    EXPECT_EQ(metrics.tmWeight, 700);
    SelectObject(dc, before);
    DeleteObject(font);
    DeleteDC(dc);
}

TEST(BlitPicture, ShowsTheTopLeftPartAndNeverStretches) {
    HBITMAP bitmap = makeBitmap({"RB.", "YMW"});
    Memory memory(blank(5, 4));
    const auto before = liveObjects();
    BlitPicture(memory.dc, 1, 1, 3, 2, bitmap);
    EXPECT_EQ(memory.text(), (Rows{"GGGGG", "GRBGG", "GGGGG", "GGGGG"}));
    BlitPicture(memory.dc, 0, 1, 5, 4, bitmap);
    EXPECT_EQ(memory.text(), (Rows{"GGGGG", "RB.GG", "YMWGG", "GGGGG"}));
    EXPECT_EQ(liveObjects(), before);
    EXPECT_TRUE(DeleteObject(bitmap));
}
