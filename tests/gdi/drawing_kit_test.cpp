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

/// A picture with a text in a font of 20 pixels.
template <class Draw>
Rows written(Draw draw) {
    const Memory memory(plain(120, 60, 'G'));
    HFONT font = MakeFont(20, 700, "MS Serif");
    const HGDIOBJ before = SelectObject(memory.dc, font);
    TEXTMETRICA metrics{};
    GetTextMetricsA(memory.dc, &metrics);
    EXPECT_EQ(metrics.tmHeight - metrics.tmInternalLeading, 20);
    EXPECT_EQ(metrics.tmWeight, 700);
    SetBkMode(memory.dc, TRANSPARENT);
    draw(memory.dc);
    SelectObject(memory.dc, before);
    DeleteObject(font);
    return memory.text();
}

/// Where the text stands if it is drawn alone.
RECT inkOf(RECT area) {
    return boundsOf(written([&](HDC dc) { DrawTextA(dc, "Mo", -1, &area, DT_CENTER); }), '.');
}

} // namespace

TEST(ShadowText, LaysEachPassOnePixelOnAndHalfAsFarAside) {
    const struct {
        int depth;
        char above, below; // the colours of the passes
        RECT farUp, farDown;
    } cases[] = {
        {1, 'W', 'x', {9, 9, 111, 60}, {11, 11, 111, 60}},
        {-2, 'x', 'W', {8, 8, 111, 60}, {12, 12, 111, 60}},
    };

    for (const auto& c : cases) {
        const Rows picture = written([&](HDC dc) {
            SetBkMode(dc, OPAQUE);
            EXPECT_GT(DrawShadowText(dc, RGB(255, 0, 0), "Mo", 10, 10, 111, 60, c.depth), 0);
            EXPECT_EQ(SetBkMode(dc, OPAQUE), OPAQUE) << "the background mode is back";
            EXPECT_EQ(SetTextColor(dc, 0), RGB(255, 0, 0)) << "the text colour stays";
        });
        EXPECT_EQ(boundsOf(picture, 'R'), inkOf({10, 10, 111, 60}));
        EXPECT_EQ(boundsOf(picture, c.above).top, inkOf(c.farUp).top);
        EXPECT_EQ(boundsOf(picture, c.above).left, inkOf(c.farUp).left);
        EXPECT_EQ(boundsOf(picture, c.below).right, inkOf(c.farDown).right);
        EXPECT_EQ(boundsOf(picture, c.below).bottom, inkOf(c.farDown).bottom);
    }
    EXPECT_EQ(inkOf({8, 8, 111, 60}).left, inkOf({10, 10, 111, 60}).left - 1);
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
