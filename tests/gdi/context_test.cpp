// Contexts, what they have selected, and who lives how long.
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

TEST(Context, ABitmapIsBlackAndOfTheFormThatIsSelected) {
    TestSurface window({"W"});
    const Memory mono({"0"});
    const Memory colour({"R"});
    DeleteObject(makeBitmap({"W"})); // its memory is used again
    HBITMAP fresh = CreateCompatibleBitmap(colour.dc, 1, 1);
    SelectObject(mono.dc, fresh);
    BitBlt(window.dc, 0, 0, 1, 1, mono.dc, 0, 0, SRCCOPY);
    EXPECT_EQ(window.pixels().bits[0], 0xFF000000U) << "black and opaque";
    SelectObject(mono.dc, mono.bitmap);
    EXPECT_TRUE(DeleteObject(fresh));
    HBITMAP mask = CreateCompatibleBitmap(mono.dc, 17, 1);
    BITMAP info{};
    EXPECT_EQ(GetObjectA(mask, sizeof(info) - 1, &info), 0);
    EXPECT_EQ(GetObjectA(mask, sizeof(info), &info), static_cast<int>(sizeof(info)));
    EXPECT_EQ(info.bmWidthBytes, 4);
    EXPECT_EQ(info.bmBitsPixel, 1);
    EXPECT_TRUE(DeleteObject(mask));
    for (const SIZE size : {SIZE{0, 5}, SIZE{5, -1}, SIZE{32767, 32767}, SIZE{1, 0x7FFFFFFF}}) {
        EXPECT_FALSE(CreateCompatibleBitmap(mono.dc, size.cx, size.cy)) << size.cx;
    }
}

TEST(Context, ABitmapIsSelectedIntoOneContextAtATime) {
    const Memory first({"R"});
    const TestSurface window({"W"});
    HDC second = CreateCompatibleDC(nullptr);
    EXPECT_FALSE(SelectObject(second, first.bitmap));
    EXPECT_EQ(SelectObject(first.dc, first.bitmap), first.bitmap);
    HBITMAP other = makeBitmap({"G"});
    EXPECT_FALSE(SelectObject(window.dc, other));
    EXPECT_TRUE(SelectObject(second, other));
    EXPECT_FALSE(DeleteObject(other));
    EXPECT_TRUE(DeleteDC(second)) << "and releases what it had";
    EXPECT_TRUE(DeleteObject(other));
    EXPECT_FALSE(DeleteObject(other));
    EXPECT_FALSE(DeleteObject(GetStockObject(BLACK_PEN)));
    EXPECT_FALSE(GetStockObject(99));
}

TEST(Context, SavedStatesComeBack) {
    const auto start = liveObjects();
    HDC dc = CreateCompatibleDC(nullptr);
    HBRUSH brush = CreateSolidBrush(RGB(0, 255, 0));
    EXPECT_EQ(SaveDC(dc), 1);
    SetTextColor(dc, RGB(255, 0, 0));
    const HGDIOBJ before = SelectObject(dc, brush);
    EXPECT_EQ(SaveDC(dc), 2);
    SelectObject(dc, before);
    EXPECT_FALSE(DeleteObject(brush)) << "a state that is kept has it selected";
    SetTextColor(dc, RGB(0, 0, 255));
    for (const int none : {3, 0, -3}) {
        EXPECT_FALSE(RestoreDC(dc, none));
    }
    EXPECT_TRUE(RestoreDC(dc, -1));
    EXPECT_EQ(SetTextColor(dc, 0), RGB(255, 0, 0));
    SaveDC(dc);
    EXPECT_TRUE(RestoreDC(dc, 1));
    EXPECT_TRUE(DeleteObject(brush)) << "the state that is back doesn't have it";
    EXPECT_FALSE(RestoreDC(dc, -1));
    DeleteDC(dc);
    EXPECT_EQ(liveObjects(), start);
}

TEST(Context, StaleAndForeignHandlesGiveNothing) {
    HDC stale = CreateCompatibleDC(nullptr);
    DeleteDC(stale);
    HDC next = CreateCompatibleDC(nullptr);
    RECT area{0, 0, 5, 5};
    SIZE size{};
    for (const HDC dc : {HDC{}, stale, HDC{GetStockObject(BLACK_PEN).number}}) {
        EXPECT_FALSE(SelectObject(dc, GetStockObject(BLACK_PEN)));
        EXPECT_FALSE(CreateCompatibleBitmap(dc, 1, 1));
        EXPECT_FALSE(BitBlt(dc, 0, 0, 1, 1, next, 0, 0, SRCCOPY));
        EXPECT_FALSE(StretchBlt(next, 0, 0, 1, 1, dc, 0, 0, 2, 2, SRCCOPY));
        EXPECT_FALSE(LineTo(dc, 1, 1));
        EXPECT_EQ(DrawTextA(dc, "text", -1, &area, 0), 0);
        EXPECT_FALSE(GetTextExtentPointA(dc, "text", 4, &size));
        EXPECT_FALSE(DeleteDC(dc));
    }
    DeleteDC(next);
}

TEST(Context, WithoutATargetDrawsNothing) {
    HDC fresh = CreateCompatibleDC(nullptr); // fresh ones share a bitmap
    TestSurface surface({"R"});
    seam::dropSurface(surface);
    const RECT area{0, 0, 1, 1};
    for (HDC dc : {fresh, surface.dc}) {
        FillRect(dc, &area, HBRUSH{GetStockObject(WHITE_BRUSH)});
    }
    const Memory seen({"R"});
    BitBlt(seen.dc, 0, 0, 1, 1, fresh, 0, 0, SRCCOPY);
    EXPECT_EQ(seen.text(), Rows{"."});
    EXPECT_EQ(surface.text(), Rows{"R"});
    DeleteDC(fresh);
}

TEST(Palette, IsSelectedAndGoesAgain) {
    const auto start = liveObjects();
    const Memory memory({"W"});
    const LOGPALETTE description{0x300, 1, {{1, 2, 3, 0}}};
    HPALETTE palette = CreatePalette(&description);
    EXPECT_EQ(liveObjects().palettes, start.palettes + 1);
    const HPALETTE before = SelectPalette(memory.dc, palette, FALSE);
    EXPECT_FALSE(DeletePalette(palette));
    EXPECT_EQ(SelectPalette(memory.dc, before, FALSE), palette);
    EXPECT_TRUE(DeletePalette(palette));
    EXPECT_FALSE(DeletePalette(before)) << "every context begins with it";
    EXPECT_EQ(liveObjects().palettes, start.palettes);
}
