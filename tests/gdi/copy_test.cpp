// Copies by the three operations, every pixel compared.
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

namespace {

struct OperationCase {
    const char* name;
    DWORD operation;
    Rows expected;
};

} // namespace

TEST(Copy, CombinesTargetAndSource) {
    const Rows source{".WRYB"};
    const OperationCase cases[] = {
        {"copy", SRCCOPY, {".WRYB", ".WRYB", ".WRYB"}},
        {"and", SRCAND, {".....", ".WRYB", ".RRR."}},
        {"or", SRCPAINT, {".WRYB", "WWWWW", "RWRYM"}},
    };
    for (const OperationCase& c : cases) {
        Memory from({source[0], source[0], source[0]});
        Memory to({".....", "WWWWW", "RRRRR"});
        EXPECT_TRUE(BitBlt(to.dc, 0, 0, 5, 3, from.dc, 0, 0, c.operation));
        EXPECT_EQ(to.text(), c.expected) << c.name;
    }
}

TEST(Copy, RefusesOtherOperations) {
    Memory from({"R"});
    Memory to({"G"});
    constexpr DWORD invert = 0x00550009;
    EXPECT_FALSE(BitBlt(to.dc, 0, 0, 1, 1, from.dc, 0, 0, invert));
    EXPECT_FALSE(StretchBlt(to.dc, 0, 0, 1, 1, from.dc, 0, 0, 1, 1, invert));
    EXPECT_EQ(to.text(), Rows{"G"});
}

TEST(Copy, ColourBecomesAMaskOfTheSourcesBackgroundColour) {
    Memory from({".WRG", "R..R"});
    Memory mask(4, 2, true);
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(mask.text(), (Rows{"0100", "0000"}));
    SetBkColor(from.dc, RGB(0, 0, 0));
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(mask.text(), (Rows{"1000", "0110"}));
    SetBkColor(from.dc, RGB(255, 0, 0));
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCPAINT);
    EXPECT_EQ(mask.text(), (Rows{"1010", "1111"}));
    SetBkColor(mask.dc, RGB(0, 255, 0));
    BitBlt(mask.dc, 0, 0, 4, 2, from.dc, 0, 0, SRCAND);
    EXPECT_EQ(mask.text(), (Rows{"0010", "1001"})) << "the target's background colour is no matter";
}

TEST(Copy, TheTopByteOfAWindowsPixelsMeansNothing) {
    TestSurface surface({".R."});
    HDC window = seam::makeSurfaceContext(surface, {0, 0, 3, 1});
    SetBkColor(window, RGB(0, 0, 0));
    Memory mask(3, 1, true);
    BitBlt(mask.dc, 0, 0, 3, 1, window, 0, 0, SRCCOPY);
    EXPECT_EQ(mask.text(), Rows{"101"});
    DeleteDC(window);
}

TEST(Copy, WhatIsDrawnOnAWindowIsOpaque) {
    TestSurface surface({"RRR"});
    HDC window = seam::makeSurfaceContext(surface, {0, 0, 3, 1});
    Memory black(3, 1, false);
    BitBlt(window, 0, 0, 3, 1, black.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(surface.pixels().bits[0], 0xFF000000U);
    EXPECT_EQ(surface.pixels().bits[2], 0xFF000000U);
    DeleteDC(window);
}

TEST(Copy, AMaskBecomesTheTargetsTwoColours) {
    Memory picture({"W.W"});
    Memory mask(3, 1, true);
    BitBlt(mask.dc, 0, 0, 3, 1, picture.dc, 0, 0, SRCCOPY);
    ASSERT_EQ(mask.text(), Rows{"101"});
    Memory to({"GGG"});
    BitBlt(to.dc, 0, 0, 3, 1, mask.dc, 0, 0, SRCAND);
    EXPECT_EQ(to.text(), Rows{"G.G"}) << "white and black in a fresh context";
    SetBkColor(to.dc, RGB(255, 0, 0));
    SetTextColor(to.dc, RGB(0, 0, 255));
    BitBlt(to.dc, 0, 0, 3, 1, mask.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(to.text(), Rows{"RBR"});
    SetTextColor(to.dc, RGB(255, 0, 0));
    SetBkColor(to.dc, RGB(0, 0, 255));
    BitBlt(to.dc, 0, 0, 3, 1, mask.dc, 0, 0, SRCPAINT);
    EXPECT_EQ(to.text(), Rows{"MMM"});
}

TEST(Copy, MasksCopyAsTheyAre) {
    Memory picture({"W.W."});
    Memory first(4, 1, true);
    Memory second(4, 1, true);
    BitBlt(first.dc, 0, 0, 4, 1, picture.dc, 0, 0, SRCCOPY);
    SetBkColor(first.dc, RGB(0, 0, 0));
    BitBlt(second.dc, 1, 0, 4, 1, first.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(second.text(), Rows{"0101"});
}

namespace {

struct ClipCase {
    int x, y, width, height, sourceX, sourceY;
    Rows expected;
};

} // namespace

TEST(Copy, IsClippedOnAllSides) {
    const ClipCase cases[] = {
        {0, 0, 3, 3, 0, 0, {"RGB.", "YWM.", "xcR.", "...."}},
        {-1, 0, 3, 3, 0, 0, {"GB..", "WM..", "cR..", "...."}},
        {0, -2, 3, 3, 0, 0, {"xcR.", "....", "....", "...."}},
        {2, 3, 3, 3, 0, 0, {"....", "....", "....", "..RG"}},
        {-3, 0, 3, 3, 0, 0, {"....", "....", "....", "...."}},
        {4, 0, 3, 3, 0, 0, {"....", "....", "....", "...."}},
        {0, -3, 3, 3, 0, 0, {"....", "....", "....", "...."}},
        {0, 4, 3, 3, 0, 0, {"....", "....", "....", "...."}},
        {0, 0, 3, 3, -1, -1, {"....", ".RG.", ".YW.", "...."}},
        {0, 0, 4, 4, 2, 1, {"M...", "R...", "....", "...."}},
        {1, 1, 3, 3, 3, 0, {"....", "....", "....", "...."}},
        {0, 0, 0, 3, 0, 0, {"....", "....", "....", "...."}},
        {0, 0, -2, 3, 0, 0, {"....", "....", "....", "...."}},
        {-2147483647 - 1, 0, 2147483647, 1, 0, 0, {"....", "....", "....", "...."}},
        {-1, -1, 2147483647, 2147483647, 0, 0, {"WM..", "cR..", "....", "...."}},
        {2147483647, 0, 2147483647, 3, -2147483647, 0, {"....", "....", "....", "...."}},
    };
    for (const ClipCase& c : cases) {
        Memory from({"RGB", "YWM", "xcR"});
        Memory to(4, 4, false);
        EXPECT_TRUE(
            BitBlt(to.dc, c.x, c.y, c.width, c.height, from.dc, c.sourceX, c.sourceY, SRCCOPY));
        EXPECT_EQ(to.text(), c.expected)
            << c.x << "," << c.y << " from " << c.sourceX << "," << c.sourceY;
    }
}

TEST(Copy, KeepsToTheClipOfAWindowAndTellsItFirst) {
    TestSurface surface({"....", "....", "...."});
    HDC window = seam::makeSurfaceContext(surface, {1, 0, 9, 2});
    Memory from({"RRRR", "GGGG", "BBBB"});
    BitBlt(window, 0, 0, 3, 3, from.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(surface.text(), (Rows{".RR.", ".GG.", "...."}));
    EXPECT_EQ(surface.touched, (std::vector<RECT>{{1, 0, 3, 2}}));
    EXPECT_EQ(surface.shown().front(), (Rows{"....", "....", "...."}));
    BitBlt(window, 0, 2, 4, 1, from.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(surface.touched.size(), 1U) << "nothing to draw, nothing to tell";
    Memory copy(4, 3, false);
    BitBlt(copy.dc, 0, 0, 4, 3, window, 0, 0, SRCCOPY);
    EXPECT_EQ(copy.text(), surface.text()) << "reading isn't clipped";
    EXPECT_EQ(surface.touched.size(), 1U);
    DeleteDC(window);
}

namespace {

struct OverlapCase {
    int x, y;
    DWORD operation;
    Rows expected;
};

} // namespace

TEST(Copy, WithinOneBitmapGivesWhatStoodBefore) {
    const OverlapCase cases[] = {
        {1, 0, SRCCOPY, {"RRGB", "WWMx", "ccRG"}},  {-1, 0, SRCCOPY, {"GBYY", "MxYY", "RGBB"}},
        {0, 1, SRCCOPY, {"RGBY", "RGBY", "WMxY"}},  {0, -1, SRCCOPY, {"WMxY", "cRGB", "cRGB"}},
        {1, 1, SRCCOPY, {"RGBY", "WRGB", "cWMx"}},  {-1, -1, SRCCOPY, {"MxYY", "RGBY", "cRGB"}},
        {1, -1, SRCCOPY, {"RWMx", "WcRG", "cRGB"}}, {-1, 1, SRCCOPY, {"RGBY", "GBYY", "MxYB"}},
    };
    for (const OverlapCase& c : cases) {
        Memory memory({"RGBY", "WMxY", "cRGB"});
        BitBlt(memory.dc, c.x, c.y, 4, 3, memory.dc, 0, 0, c.operation);
        EXPECT_EQ(memory.text(), c.expected) << c.x << "," << c.y;
    }
    Memory memory({"RG.."});
    BitBlt(memory.dc, 1, 0, 3, 1, memory.dc, 0, 0, SRCPAINT);
    EXPECT_EQ(memory.text(), Rows{"RYG."});
}

namespace {

struct StretchCase {
    int x, y, width, height, sourceX, sourceY, sourceWidth, sourceHeight;
    Rows expected;
};

} // namespace

TEST(Stretch, RepeatsAndLeavesOut) {
    const StretchCase cases[] = {
        {0, 0, 4, 4, 0, 0, 2, 2, {"RRGG", "RRGG", "BBYY", "BBYY"}},
        {0, 0, 2, 2, 0, 0, 2, 2, {"RG..", "BY..", "....", "...."}},
        {1, 1, 1, 2, 0, 0, 2, 2, {"....", ".R..", ".B..", "...."}},
        {-1, 0, 4, 2, 0, 0, 2, 2, {"RGG.", "BYY.", "....", "...."}},
        {0, 0, 4, 4, 1, 0, 2, 2, {"GG..", "GG..", "YY..", "YY.."}},
        {0, 0, 4, 4, -1, -1, 2, 2, {"....", "....", "..RR", "..RR"}},
        {2, 3, 6, 6, 0, 0, 2, 2, {"....", "....", "....", "..RR"}},
        {0, 0, 4, 4, 5, 0, 2, 2, {"....", "....", "....", "...."}},
    };
    for (const StretchCase& c : cases) {
        Memory from({"RG", "BY"});
        Memory to(4, 4, false);
        EXPECT_TRUE(StretchBlt(to.dc, c.x, c.y, c.width, c.height, from.dc, c.sourceX, c.sourceY,
                               c.sourceWidth, c.sourceHeight, SRCCOPY));
        EXPECT_EQ(to.text(), c.expected)
            << c.x << "," << c.y << " " << c.width << "x" << c.height << " from " << c.sourceX;
    }
}

TEST(Stretch, RefusesSizesBelowOne) {
    Memory from({"RG", "BY"});
    Memory to(2, 2, false);
    EXPECT_FALSE(StretchBlt(to.dc, 0, 0, 0, 2, from.dc, 0, 0, 2, 2, SRCCOPY));
    EXPECT_FALSE(StretchBlt(to.dc, 0, 0, 2, 2, from.dc, 0, 0, 2, -2, SRCCOPY));
    EXPECT_FALSE(StretchBlt(to.dc, 0, 0, 0, 0, from.dc, 0, 0, 0, 0, SRCCOPY));
    EXPECT_EQ(to.text(), (Rows{"..", ".."}));
}

TEST(Stretch, MayCopyWithinOneBitmap) {
    Memory memory({"RG.."});
    StretchBlt(memory.dc, 0, 0, 4, 1, memory.dc, 0, 0, 2, 1, SRCCOPY);
    EXPECT_EQ(memory.text(), Rows{"RRGG"});
}
