// Contexts, what they have selected, and who lives how long.
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

TEST(Context, FreshOneHoldsTheStockObjectsAndPlainColours) {
    HDC dc = CreateCompatibleDC(nullptr);
    EXPECT_EQ(SelectObject(dc, GetStockObject(WHITE_PEN)), GetStockObject(BLACK_PEN));
    EXPECT_EQ(SelectObject(dc, GetStockObject(BLACK_BRUSH)), GetStockObject(WHITE_BRUSH));
    EXPECT_EQ(SetBkColor(dc, RGB(1, 2, 3)), RGB(255, 255, 255));
    EXPECT_EQ(SetTextColor(dc, RGB(4, 5, 6)), RGB(0, 0, 0));
    EXPECT_EQ(SetBkMode(dc, TRANSPARENT), OPAQUE);
    EXPECT_EQ(SetStretchBltMode(dc, BLACKONWHITE), BLACKONWHITE);
    EXPECT_EQ(GetMapMode(dc), MM_TEXT);
    EXPECT_EQ(SetMapMode(dc, MM_TEXT), MM_TEXT);
    EXPECT_EQ(SetMapMode(dc, 2), 0);
    EXPECT_EQ(SetBkColor(dc, 0), RGB(1, 2, 3));
    DeleteDC(dc);
}

TEST(Context, ABitmapCompatibleWithAFreshContextIsMonochrome) {
    TestSurface surface({"W"});
    HDC window = seam::makeSurfaceContext(surface, {0, 0, 1, 1});
    HDC memory = CreateCompatibleDC(window);
    HBITMAP mono = CreateCompatibleBitmap(memory, 17, 2);
    HBITMAP colour = CreateCompatibleBitmap(window, 17, 2);
    const HGDIOBJ before = SelectObject(memory, colour);
    HBITMAP colourToo = CreateCompatibleBitmap(memory, 1, 1);
    BITMAP info{};
    EXPECT_EQ(GetObjectA(mono, sizeof(info), &info), static_cast<int>(sizeof(BITMAP)));
    EXPECT_EQ(info.bmBitsPixel, 1);
    EXPECT_EQ(info.bmWidthBytes, 4);
    EXPECT_EQ(info.bmWidth, 17);
    EXPECT_EQ(info.bmHeight, 2);
    GetObjectA(colour, sizeof(info), &info);
    EXPECT_EQ(info.bmBitsPixel, 32);
    EXPECT_EQ(info.bmWidthBytes, 68);
    GetObjectA(colourToo, sizeof(info), &info);
    EXPECT_EQ(info.bmBitsPixel, 32);
    EXPECT_EQ(GetObjectA(colour, sizeof(info) - 1, &info), 0);
    EXPECT_EQ(GetObjectA(GetStockObject(BLACK_PEN), sizeof(info), &info), 0);
    SelectObject(memory, before);
    DeleteDC(memory);
    DeleteDC(window);
    DeleteObject(mono);
    DeleteObject(colour);
    DeleteObject(colourToo);
}

TEST(Context, ANewBitmapIsBlackAlsoInTheMemoryOfAnOldOne) {
    Memory dirty({"RG", "BY"});
    HBITMAP old = makeBitmap({"WW", "WW"});
    DeleteObject(old);
    HBITMAP fresh = CreateCompatibleBitmap(dirty.dc, 2, 2);
    EXPECT_EQ(textOf(fresh), (Rows{"..", ".."}));
    DeleteObject(fresh);
}

TEST(Context, BitmapsOfNoSizeOrOutOfAllReasonAreRefused) {
    HDC dc = CreateCompatibleDC(nullptr);
    const auto before = liveObjects();
    for (const SIZE size : {SIZE{0, 5}, SIZE{5, 0}, SIZE{-1, 5}, SIZE{5, -1}, SIZE{32767, 32767},
                            SIZE{1, 0x7FFFFFFF}}) {
        EXPECT_FALSE(CreateCompatibleBitmap(dc, size.cx, size.cy)) << size.cx << "x" << size.cy;
    }
    EXPECT_EQ(liveObjects(), before);
    DeleteDC(dc);
}

TEST(Context, APictureOfAWholeStageCanBeMadeAndFilled) {
    Memory colour({"W"});
    HBITMAP picture = CreateCompatibleBitmap(colour.dc, 1920, 1080);
    HDC dc = CreateCompatibleDC(nullptr);
    const HGDIOBJ before = SelectObject(dc, picture);
    const RECT corner{1919, 1079, 1920, 1080};
    FillRect(dc, &corner, HBRUSH{GetStockObject(WHITE_BRUSH)});
    EXPECT_EQ(GetPixel(dc, 1919, 1079), RGB(255, 255, 255));
    EXPECT_EQ(GetPixel(dc, 1918, 1079), RGB(0, 0, 0));
    SelectObject(dc, before);
    DeleteDC(dc);
    EXPECT_TRUE(DeleteObject(picture));
}

TEST(Context, ABitmapIsSelectedIntoOneContextAtATime) {
    Memory first({"R"});
    HDC second = CreateCompatibleDC(first.dc);
    EXPECT_FALSE(SelectObject(second, first.bitmap));
    EXPECT_EQ(SelectObject(first.dc, first.bitmap), first.bitmap);
    TestSurface surface({"W"});
    HDC window = seam::makeSurfaceContext(surface, {0, 0, 1, 1});
    HBITMAP other = CreateCompatibleBitmap(window, 1, 1);
    EXPECT_FALSE(SelectObject(window, other));
    EXPECT_TRUE(SelectObject(second, other));
    DeleteDC(window);
    DeleteDC(second);
    EXPECT_TRUE(DeleteObject(other));
}

TEST(Context, WhatIsSelectedOrStockIsNotDeleted) {
    HDC dc = CreateCompatibleDC(nullptr);
    HPEN pen = CreatePen(PS_SOLID, 1, RGB(255, 0, 0));
    const HGDIOBJ before = SelectObject(dc, pen);
    EXPECT_FALSE(DeleteObject(pen));
    SaveDC(dc);
    SelectObject(dc, before);
    EXPECT_FALSE(DeleteObject(pen)) << "a state that is kept has it selected";
    RestoreDC(dc, -1);
    SelectObject(dc, before);
    EXPECT_TRUE(DeleteObject(pen));
    EXPECT_FALSE(DeleteObject(pen));
    EXPECT_FALSE(SelectObject(dc, pen));
    EXPECT_FALSE(DeleteObject(GetStockObject(BLACK_PEN)));
    EXPECT_FALSE(GetStockObject(-1));
    EXPECT_FALSE(GetStockObject(99));
    DeleteDC(dc);
}

TEST(Context, SavedStatesComeBack) {
    const auto start = liveObjects();
    HDC dc = CreateCompatibleDC(nullptr);
    HBRUSH brush = CreateSolidBrush(RGB(0, 255, 0));
    EXPECT_EQ(SaveDC(dc), 1);
    SetTextColor(dc, RGB(255, 0, 0));
    MoveToEx(dc, 3, 4, nullptr);
    EXPECT_EQ(SaveDC(dc), 2);
    SelectObject(dc, brush);
    SetTextColor(dc, RGB(0, 0, 255));
    EXPECT_FALSE(RestoreDC(dc, 3));
    EXPECT_FALSE(RestoreDC(dc, 0));
    EXPECT_FALSE(RestoreDC(dc, -3));
    EXPECT_TRUE(RestoreDC(dc, -1));
    EXPECT_EQ(SetTextColor(dc, 0), RGB(255, 0, 0));
    POINT position{};
    MoveToEx(dc, 0, 0, &position);
    EXPECT_EQ(position.x, 3);
    EXPECT_EQ(position.y, 4);
    EXPECT_TRUE(DeleteObject(brush)) << "the state that is back doesn't have it";
    SaveDC(dc);
    EXPECT_TRUE(RestoreDC(dc, 1));
    EXPECT_EQ(SetTextColor(dc, 0), RGB(0, 0, 0));
    EXPECT_FALSE(RestoreDC(dc, -1));
    DeleteDC(dc);
    EXPECT_EQ(liveObjects(), start);
}

TEST(Context, DeletingOneReleasesAllThatItHad) {
    HDC dc = CreateCompatibleDC(nullptr);
    HPEN pen = CreatePen(PS_SOLID, 1, 0);
    HFONT font = CreateFontA(-14, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, 0, "MS Serif");
    SelectObject(dc, pen);
    SaveDC(dc);
    SelectObject(dc, font);
    EXPECT_TRUE(DeleteDC(dc));
    EXPECT_FALSE(DeleteDC(dc));
    EXPECT_TRUE(DeleteObject(pen));
    EXPECT_TRUE(DeleteObject(font));
}

TEST(Context, StaleAndForeignHandlesGiveNothing) {
    HDC stale = CreateCompatibleDC(nullptr);
    DeleteDC(stale);
    const HDC foreign{GetStockObject(BLACK_PEN).number};
    RECT area{0, 0, 5, 5};
    SIZE size{};
    TEXTMETRICA metrics{};
    for (const HDC dc : {HDC{}, stale, foreign}) {
        EXPECT_FALSE(SelectObject(dc, GetStockObject(BLACK_PEN)));
        EXPECT_EQ(SaveDC(dc), 0);
        EXPECT_FALSE(RestoreDC(dc, -1));
        EXPECT_EQ(SetBkMode(dc, OPAQUE), 0);
        EXPECT_EQ(GetMapMode(dc), 0);
        EXPECT_FALSE(DPtoLP(dc, nullptr, 0));
        EXPECT_FALSE(CreateCompatibleBitmap(dc, 1, 1));
        EXPECT_FALSE(BitBlt(dc, 0, 0, 1, 1, dc, 0, 0, SRCCOPY));
        EXPECT_FALSE(StretchBlt(dc, 0, 0, 1, 1, dc, 0, 0, 2, 2, SRCCOPY));
        EXPECT_FALSE(MoveToEx(dc, 0, 0, nullptr));
        EXPECT_FALSE(LineTo(dc, 1, 1));
        EXPECT_FALSE(Rectangle(dc, 0, 0, 1, 1));
        EXPECT_EQ(FillRect(dc, &area, HBRUSH{GetStockObject(WHITE_BRUSH)}), 0);
        EXPECT_EQ(GetPixel(dc, 0, 0), CLR_INVALID);
        EXPECT_EQ(DrawTextA(dc, "text", -1, &area, 0), 0);
        EXPECT_FALSE(GetTextExtentPointA(dc, "text", 4, &size));
        EXPECT_FALSE(GetTextMetricsA(dc, &metrics));
        EXPECT_FALSE(SelectPalette(dc, nullptr, FALSE));
    }
    EXPECT_EQ(seam::bitmapPicture(HBITMAP{GetStockObject(BLACK_PEN)}).width, 0);
}

TEST(Context, NothingIsDrawnOnTheBitmapThatFreshContextsShare) {
    HDC first = CreateCompatibleDC(nullptr);
    HDC second = CreateCompatibleDC(nullptr);
    const RECT area{0, 0, 1, 1};
    FillRect(first, &area, HBRUSH{GetStockObject(WHITE_BRUSH)});
    EXPECT_EQ(GetPixel(second, 0, 0), RGB(0, 0, 0));
    DeleteDC(first);
    DeleteDC(second);
}

TEST(Context, DrawsNothingOnceItsSurfaceHasGone) {
    HDC dc{};
    {
        TestSurface surface({"RR", "RR"});
        dc = seam::makeSurfaceContext(surface, {0, 0, 2, 2});
        seam::dropSurface(surface);
    }
    const RECT area{0, 0, 2, 2};
    FillRect(dc, &area, HBRUSH{GetStockObject(WHITE_BRUSH)});
    EXPECT_EQ(GetPixel(dc, 0, 0), CLR_INVALID);
    HBITMAP bitmap = CreateCompatibleBitmap(dc, 1, 1);
    EXPECT_TRUE(DeleteObject(bitmap));
    EXPECT_TRUE(DeleteDC(dc));
}

TEST(Context, StockObjectsDontCount) {
    const auto before = liveObjects();
    GetStockObject(SYSTEM_FONT);
    HBRUSH brush = CreateSolidBrush(0);
    HDC dc = CreateCompatibleDC(nullptr);
    auto expected = before;
    expected.gdiObjects += 1;
    expected.deviceContexts += 1;
    EXPECT_EQ(liveObjects(), expected);
    DeleteDC(dc);
    DeleteObject(brush);
    EXPECT_EQ(liveObjects(), before);
}

TEST(Palette, IsSelectedAndGoesAgain) {
    const auto start = liveObjects();
    HDC dc = CreateCompatibleDC(nullptr);
    const LOGPALETTE description{0x300, 1, {{1, 2, 3, 0}}};
    HPALETTE palette = CreatePalette(&description);
    EXPECT_EQ(liveObjects().palettes, start.palettes + 1);
    const HPALETTE before = SelectPalette(dc, palette, FALSE);
    EXPECT_TRUE(before);
    EXPECT_EQ(RealizePalette(dc), 0U);
    EXPECT_FALSE(DeletePalette(palette));
    EXPECT_EQ(SelectPalette(dc, before, FALSE), palette);
    EXPECT_TRUE(DeletePalette(palette));
    EXPECT_FALSE(DeletePalette(palette));
    EXPECT_FALSE(DeletePalette(before));
    EXPECT_FALSE(SelectPalette(dc, palette, FALSE));
    DeleteDC(dc);
    EXPECT_EQ(liveObjects(), start);
}
