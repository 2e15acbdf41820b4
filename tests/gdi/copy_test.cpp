// Copies by the three operations, every pixel compared.
#include "tests/gdi/pictures.h"

#include <climits>
#include <functional>
#include <gtest/gtest.h>

using namespace test;

TEST(Copy, CombinesTargetAndSource) {
    const std::tuple<const char*, DWORD, Rows> cases[] = {
        {"copy", SRCCOPY, {".WRYB", ".WRYB", ".WRYB"}},
        {"and", SRCAND, {".....", ".WRYB", ".RRR."}},
        {"or", SRCPAINT, {".WRYB", "WWWWW", "RWRYM"}},
    };
    for (const auto& [name, operation, expected] : cases) {
        const Memory from({".WRYB", ".WRYB", ".WRYB"});
        const Memory to({".....", "WWWWW", "RRRRR"});
        EXPECT_TRUE(BitBlt(to.dc, 0, 0, 5, 3, from.dc, 0, 0, operation));
        EXPECT_EQ(to.text(), expected) << name;
    }
}

TEST(Copy, ColourBecomesAMaskOfTheSourcesBackgroundColour) {
    TestSurface from({".WRG", "R..R"});
    for (int i = 0; i < 8; ++i) {
        from.pixels().bits[i] &= 0xFFFFFFU; // the top byte of a window's pixels means nothing
    }
    const Memory mask({"0000", "0000"});
    SetBkColor(from.dc, RGB(0, 0, 0));
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(mask.text(), (Rows{"1000", "0110"}));
    SetBkColor(from.dc, RGB(255, 0, 0));
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCPAINT);
    EXPECT_EQ(mask.text(), (Rows{"1010", "1111"}));
    SetBkColor(mask.dc, RGB(0, 255, 0));
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCAND);
    EXPECT_EQ(mask.text(), (Rows{"0010", "1001"})) << "the target's background colour is no matter";
    const Memory other({"0000", "0000"});
    BitBlt(other.dc, 1, 0, 4, 2, mask.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(other.text(), (Rows{"0001", "0100"})) << "between masks no colour matters";
}

TEST(Copy, AMaskBecomesTheTargetsTwoColours) {
    const Memory mask({"101"});
    const Memory to({"GGG"});
    BitBlt(to.dc, 0, 0, 3, 1, mask.dc, 0, 0, SRCAND);
    EXPECT_EQ(to.text(), Rows{"G.G"}) << "white and black in a fresh context";
    SetBkColor(to.dc, RGB(255, 0, 0));
    SetTextColor(to.dc, RGB(0, 0, 255));
    BitBlt(to.dc, 0, 0, 3, 1, mask.dc, 0, 0, SRCPAINT);
    EXPECT_EQ(to.text(), Rows{"YBY"});
}

TEST(Copy, IsClippedOnAllSidesAndStretchedByRepeating) {
    const struct {
        int x, y, width, height, sourceX, sourceY, sourceWidth, sourceHeight;
        Rows expected;
    } cases[] = {
        {-1, 0, 3, 3, 0, 0, 3, 3, {"GB..", "WM..", "cR..", "...."}},
        {0, -2, 3, 3, 0, 0, 3, 3, {"xcR.", "....", "....", "...."}},
        {2, 3, 3, 3, 0, 0, 3, 3, {"....", "....", "....", "..RG"}},
        {0, 0, 3, 3, -1, -1, 3, 3, {"....", ".RG.", ".YW.", "...."}},
        {-3, 0, 3, 3, 0, 0, 3, 3, plain(4, 4, '.')},
        {INT_MAX, 0, INT_MAX, 3, -INT_MAX, 0, INT_MAX, 3, plain(4, 4, '.')},
        {1, 1, 1, 2, 0, 0, 2, 2, {"....", ".R..", ".Y..", "...."}},
        {-1, 0, 4, 2, 0, 0, 2, 2, {"RGG.", "YWW.", "....", "...."}},
        {0, 0, 4, 4, 2, 1, 2, 2, {"MM..", "MM..", "RR..", "RR.."}},
        {0, 0, 4, 4, -1, -1, 2, 2, {"....", "....", "..RR", "..RR"}},
        {2, 3, 6, 6, 0, 0, 2, 2, {"....", "....", "....", "..RR"}},
    };

    const Memory from({"RGB", "YWM", "xcR"});
    for (const auto& c : cases) {
        const Memory to(plain(4, 4, '.'));
        EXPECT_TRUE(StretchBlt(to.dc, c.x, c.y, c.width, c.height, from.dc, c.sourceX, c.sourceY,
                               c.sourceWidth, c.sourceHeight, SRCCOPY));
        EXPECT_EQ(to.text(), c.expected) << (&c - cases);
    }
}

TEST(Copy, KeepsToTheClipOfAWindowAndTellsItFirst) {
    TestSurface window(plain(4, 3, 'W'), {1, 0, 9, 2});
    const Memory from({"....", "....", "...."});
    BitBlt(window.dc, 0, 0, 3, 3, from.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(window.text(), (Rows{"W..W", "W..W", "WWWW"}));
    EXPECT_EQ(window.touched, (std::vector<RECT>{{1, 0, 3, 2}}));
    EXPECT_EQ(window.before.front(), plain(4, 3, 'W'));
    BitBlt(window.dc, 0, 2, 4, 1, from.dc, 0, 0, SRCCOPY);
    BitBlt(from.dc, 0, 0, 4, 3, window.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(window.touched.size(), 1U) << "nothing to draw, nothing to tell";
    EXPECT_EQ(from.text(), window.text()) << "reading isn't clipped";
}

TEST(Copy, WithinOneBitmapGivesWhatStoodBefore) {
    const std::tuple<int, int, Rows> cases[] = {
        {1, 0, {"RRGB", "WWMx", "ccRG"}},
        {-1, 0, {"GBYY", "MxYY", "RGBB"}},
        {1, -1, {"RWMx", "WcRG", "cRGB"}},
        {-1, 1, {"RGBY", "GBYY", "MxYB"}},
    };
    for (const auto& [x, y, expected] : cases) {
        const Memory memory({"RGBY", "WMxY", "cRGB"});
        BitBlt(memory.dc, x, y, 4, 3, memory.dc, 0, 0, SRCCOPY);
        EXPECT_EQ(memory.text(), expected) << x << "," << y;
    }
    const Memory memory({"RG.."});
    BitBlt(memory.dc, 1, 0, 3, 1, memory.dc, 0, 0, SRCPAINT);
    EXPECT_EQ(memory.text(), Rows{"RYG."});
    StretchBlt(memory.dc, 0, 0, 4, 1, memory.dc, 0, 0, 2, 1, SRCCOPY);
    EXPECT_EQ(memory.text(), Rows{"RRYY"});
}

/// A large bitmap, which is kept as its tile while it can be, or one that has its pixels at once.
static HBITMAP makeLarge(const Memory& context, bool withPixels) {
    constexpr int width = 700;
    constexpr int height = 400;
    const HBITMAP bitmap = CreateCompatibleBitmap(context.dc, width, height);
    if (withPixels) {
        seam::bitmapPicture(bitmap);
    }
    SelectObject(context.dc, bitmap);
    return bitmap;
}

TEST(Copy, ATiledBitmapIsWhatItsPixelsWouldBe) {
    const Memory tile({"RGB", "YWM"});
    const Memory other({"RGB", "YWx"});

    const struct {
        const char* name;
        int tilesUntil; // the row
        std::function<void(HDC)> then;
    } cases[] = {
        {"tiled", 400, [](HDC) {}},
        {"half of it", 201, [](HDC) {}},
        {"a row that isn't done", 200,
         [&](HDC dc) { BitBlt(dc, 0, 200, 3, 2, tile.dc, 0, 0, SRCCOPY); }},
        {"out of turn", 200, [&](HDC dc) { BitBlt(dc, 3, 200, 3, 2, tile.dc, 0, 0, SRCCOPY); }},
        {"another tile", 200, [&](HDC dc) { BitBlt(dc, 0, 200, 3, 2, other.dc, 0, 0, SRCCOPY); }},
        {"a part of one", 200, [&](HDC dc) { BitBlt(dc, 0, 200, 2, 2, tile.dc, 0, 0, SRCCOPY); }},
        {"from within one", 200, [&](HDC dc) { BitBlt(dc, 0, 200, 3, 2, tile.dc, 1, 0, SRCCOPY); }},
        {"combined", 200, [&](HDC dc) { BitBlt(dc, 0, 200, 3, 2, tile.dc, 0, 0, SRCAND); }},
        {"drawn on", 400, [](HDC dc) { Rectangle(dc, 1, 1, 5, 3); }},
        {"over itself", 400, [](HDC dc) { BitBlt(dc, 1, 1, 6, 6, dc, 0, 0, SRCCOPY); }},
    };

    for (const auto& c : cases) {
        seam::Picture pictures[2];
        Rows seen[2];
        for (const bool withPixels : {false, true}) {
            const Memory context({"."});
            const HBITMAP bitmap = makeLarge(context, withPixels);
            for (int y = 0; y < c.tilesUntil; y += 2) {
                for (int x = 0; x < 700; x += 3) {
                    BitBlt(context.dc, x, y, 3, 2, tile.dc, 0, 0, SRCCOPY);
                }
            }
            c.then(context.dc);
            TestSurface window(plain(9, 6, 'c'), {1, 0, 8, 6});
            BitBlt(window.dc, 0, 1, 8, 8, context.dc, 2, 197, SRCCOPY);
            BitBlt(window.dc, 6, 0, 8, 2, context.dc, 697, 399, SRCCOPY);
            const Memory mask({"0000"});
            BitBlt(mask.dc, 0, 0, 4, 1, context.dc, 0, 0, SRCCOPY);
            seen[withPixels] = window.text();
            seen[withPixels].push_back(mask.text().front());
            pictures[withPixels] = seam::bitmapPicture(bitmap);
            SelectObject(context.dc, context.bitmap);
            DeleteObject(bitmap);
        }
        EXPECT_EQ(seen[0], seen[1]) << c.name;
        EXPECT_EQ(pictures[0].pixels, pictures[1].pixels) << c.name;
    }
}
