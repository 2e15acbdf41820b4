// Bevels, shadows and plain pictures. 'x' is the dark side, 'W' the light one.
#include "platform/drawing_kit.h"
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

TEST(Bevel, DrawsRingsInwards) {
    const std::pair<int, Rows> cases[] = {
        {0, plain(7, 6, 'G')},
        {1, {"GGGGGGG", "GxxxxWG", "GxGGGWG", "GxGGGWG", "GxGWWWG", "GGGGGGG"}},
        {2, {"GGGGGGG", "GxxxxWG", "GxxxWWG", "GxxGWWG", "GxGWWWG", "GGGGGGG"}},
    };
    for (const auto& [width, expected] : cases) {
        const Memory memory(plain(7, 6, 'G'));
        const auto before = liveObjects();
        DrawBevel(memory.dc, 1, 1, 6, 5, width);
        EXPECT_EQ(memory.text(), expected) << width;
        EXPECT_EQ(liveObjects(), before);
    }
}

TEST(Bevel, TheBoxIsTheSameInsideForBothSigns) {
    const Memory memory(plain(6, 5, 'G'));
    SelectObject(memory.dc, GetStockObject(LTGRAY_BRUSH));
    EXPECT_TRUE(DrawBevelBox(memory.dc, 0, 0, 6, 5, 1));
    EXPECT_EQ(memory.text(), (Rows{"xxxxxW", "x....W", "x.cc.W", "x....W", "xGWWWW"}));
    EXPECT_TRUE(DrawBevelBox(memory.dc, 0, 0, 6, 5, -1));
    EXPECT_EQ(memory.text(), (Rows{"WWWWWx", "W....x", "W.cc.x", "W....x", "WGxxxx"}));
}

namespace {

/// What is drawn in bold letters of 20 pixels on green.
template <class Draw>
Rows written(Draw draw) {
    const Memory memory(plain(120, 60, 'G'));
    const HFONT font = MakeFont(20, 700, "MS Serif");
    const HGDIOBJ before = SelectObject(memory.dc, font);
    draw(memory.dc);
    EXPECT_EQ(SetBkMode(memory.dc, OPAQUE), OPAQUE) << "as it was before";
    SelectObject(memory.dc, before);
    DeleteObject(font);
    return memory.text();
}

} // namespace

TEST(ShadowText, LaysEachPassOnePixelOnAndHalfAsFarAside) {
    struct Pass {
        COLORREF colour;
        RECT area;
    };

    constexpr COLORREF light = RGB(255, 255, 255);
    constexpr COLORREF dark = RGB(128, 128, 128);
    constexpr COLORREF own = RGB(255, 0, 0);
    const std::pair<int, std::vector<Pass>> cases[] = {
        {1, {{light, {9, 9, 111, 60}}, {dark, {11, 11, 111, 60}}, {own, {10, 10, 111, 60}}}},
        {-2,
         {{dark, {8, 8, 111, 60}},
          {dark, {9, 9, 111, 60}},
          {light, {11, 11, 111, 60}},
          {light, {12, 12, 111, 60}},
          {own, {10, 10, 111, 60}}}},
    };
    for (const auto& [depth, passes] : cases) {
        const Rows expected = written([&passes = passes](HDC dc) {
            SetBkMode(dc, TRANSPARENT);
            for (Pass pass : passes) {
                SetTextColor(dc, pass.colour);
                DrawTextA(dc, "Mo", -1, &pass.area, DT_CENTER);
            }
            SetBkMode(dc, OPAQUE);
        });
        const Rows shadowed = written(
            [depth = depth](HDC dc) { DrawShadowText(dc, own, "Mo", 10, 10, 111, 60, depth); });
        EXPECT_EQ(shadowed, expected) << depth;
    }
}

TEST(BlitPicture, ShowsTheTopLeftPartAndNeverStretches) {
    HBITMAP bitmap = makeBitmap({"RB.", "YMW"});
    const Memory memory(plain(5, 4, 'G'));
    BlitPicture(memory.dc, 1, 1, 3, 2, bitmap);
    EXPECT_EQ(memory.text(), (Rows{"GGGGG", "GRBGG", "GGGGG", "GGGGG"}));
    BlitPicture(memory.dc, 0, 1, 5, 4, bitmap);
    EXPECT_EQ(memory.text(), (Rows{"GGGGG", "RB.GG", "YMWGG", "GGGGG"}));
    EXPECT_TRUE(DeleteObject(bitmap)) << "nothing has it selected";
}
