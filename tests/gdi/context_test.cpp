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

TEST(Context, StaleAndForeignHandlesGiveNothing) {
    HDC stale = CreateCompatibleDC(nullptr);
    DeleteDC(stale);
    HDC next = CreateCompatibleDC(nullptr);
    RECT area{0, 0, 5, 5};
    for (const HDC dc : {HDC{}, stale, HDC{GetStockObject(BLACK_PEN).number}}) {
        EXPECT_FALSE(SelectObject(dc, GetStockObject(BLACK_PEN)));
        EXPECT_FALSE(CreateCompatibleBitmap(dc, 1, 1));
        EXPECT_FALSE(BitBlt(next, 0, 0, 1, 1, dc, 0, 0, SRCCOPY));
        EXPECT_EQ(DrawTextA(dc, "text", -1, &area, 0), 0);
        EXPECT_FALSE(DeleteDC(dc));
    }
    DeleteDC(next);
}
