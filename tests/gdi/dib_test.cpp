// Bitmaps from bytes.
#include "tests/gdi/pictures.h"

#include <gtest/gtest.h>

using namespace test;

namespace {

using Bytes = std::vector<BYTE>;

/// Head and colours, one behind the other.
struct Info {
    BITMAPINFOHEADER head{};
    BYTE colours[12] = {0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0}; // blue, green, red, 0 each

    Info(LONG width, LONG height, WORD bits) {
        head.biSize = sizeof(head);
        head.biWidth = width;
        head.biHeight = height;
        head.biPlanes = 1;
        head.biBitCount = bits;
        head.biClrUsed = bits == 24 || bits == 1 ? 0 : 3; // 0 for all of the depth
    }
};

HBITMAP make(const Info& info, const Bytes& rows) {
    HDC dc = CreateCompatibleDC(nullptr);
    HBITMAP bitmap = CreateDIBitmap(dc, &info.head, CBM_INIT, rows.data(), &info.head, 0);
    DeleteDC(dc);
    return bitmap;
}

} // namespace

TEST(Dib, ReadsEachDepthFromTheBottomUp) {
    // Each row is filled up to four bytes, here with 9.
    const std::tuple<Info, Bytes, Rows> cases[] = {
        {{3, 2, 1}, {0x40, 9, 9, 9, 0xA0, 9, 9, 9}, {"GRG", "RGR"}},
        {{3, 2, 4}, {0x01, 0x2F, 9, 9, 0x21, 0x0F, 9, 9}, {"BGR", "RGB"}},
        {{5, 2, 8}, {0, 1, 2, 1, 0, 9, 9, 9, 2, 2, 1, 0, 0, 9, 9, 9}, {"BBGRR", "RGBGR"}},
        {{1, 2, 24}, {0xFF, 0, 0, 9, 0, 0, 0xFF, 9}, {"R", "B"}},
        {{1, -2, 8}, {0, 9, 9, 9, 1, 9, 9, 9}, {"R", "G"}}, // from the top down
        {{4, 1, 8}, {2, 3, 255, 0}, {"B..R"}},              // black beyond the colours
    };
    for (const auto& [info, rows, expected] : cases) {
        HBITMAP bitmap = make(info, rows);
        EXPECT_EQ(textOf(bitmap), expected) << info.head.biBitCount;
        DeleteObject(bitmap);
    }
}
