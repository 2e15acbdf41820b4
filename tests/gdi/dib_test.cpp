// Bitmaps from bytes.
#include "platform/kernel.h"
#include "tests/gdi/pictures.h"

#include <cstring>
#include <gtest/gtest.h>

using namespace test;

namespace {

/// A device-independent bitmap in the making.
struct Packed {
    BITMAPINFOHEADER head{};
    std::vector<BYTE> colours; // blue, green, red, 0 each
    std::vector<BYTE> rows;

    Packed(LONG width, LONG height, WORD bits, std::vector<BYTE> rowBytes)
        : colours{0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0xFF, 0, 0, 0}, rows(std::move(rowBytes)) {
        head.biSize = sizeof(head);
        head.biWidth = width;
        head.biHeight = height;
        head.biPlanes = 1;
        head.biBitCount = bits;
        head.biClrUsed = bits == 24 ? 0 : 3;
    }

    /// Head and colours one behind the other.
    std::vector<BYTE> info() const {
        std::vector<BYTE> bytes(sizeof(head));
        std::memcpy(bytes.data(), &head, sizeof(head));
        bytes.insert(bytes.end(), colours.begin(), colours.end());
        return bytes;
    }
};

HBITMAP make(const Packed& packed) {
    HDC dc = CreateCompatibleDC(nullptr);
    const std::vector<BYTE> bytes = packed.info();
    const auto* info = reinterpret_cast<const BITMAPINFOHEADER*>(bytes.data());
    HBITMAP bitmap = CreateDIBitmap(dc, info, CBM_INIT, packed.rows.data(), info, DIB_RGB_COLORS);
    DeleteDC(dc);
    return bitmap;
}

Rows pictureOf(const Packed& packed) {
    HBITMAP bitmap = make(packed);
    Rows rows = textOf(bitmap);
    DeleteObject(bitmap);
    return rows;
}

} // namespace

TEST(Dib, ReadsEachDepthFromTheBottomUp) {
    Packed one(3, 2, 1, {0x40, 9, 9, 9, 0xA0, 9, 9, 9});
    EXPECT_EQ(pictureOf(one), (Rows{"GRG", "RGR"}));
    Packed four(3, 2, 4, {0x01, 0x2F, 9, 9, 0x21, 0x0F, 9, 9});
    EXPECT_EQ(pictureOf(four), (Rows{"BGR", "RGB"}));
    Packed eight(5, 2, 8, {0, 1, 2, 1, 0, 9, 9, 9, 2, 2, 1, 0, 0, 9, 9, 9});
    EXPECT_EQ(pictureOf(eight), (Rows{"BBGRR", "RGBGR"}));
    Packed full(2, 2, 24, {0xFF, 0, 0, 0, 0xFF, 0, 9, 9, 0, 0, 0xFF, 0xFF, 0xFF, 0xFF, 9, 9});
    EXPECT_EQ(pictureOf(full), (Rows{"RW", "BG"}));
}

TEST(Dib, ANegativeHeightMeansFromTheTopDown) {
    EXPECT_EQ(pictureOf(Packed(1, -2, 8, {0, 9, 9, 9, 1, 9, 9, 9})), (Rows{"R", "G"}));
}

TEST(Dib, AnIndexBeyondTheColoursIsBlack) {
    EXPECT_EQ(pictureOf(Packed(4, 1, 8, {2, 3, 255, 0})), Rows{"B..R"});
}

TEST(Dib, ZeroColoursUsedMeansAllOfTheDepth) {
    Packed packed(2, 1, 1, {0x40, 9, 9, 9});
    packed.head.biClrUsed = 0;
    EXPECT_EQ(pictureOf(packed), Rows{"RG"});
}

TEST(Dib, IsOfTheDisplaysForm) {
    HBITMAP bitmap = make(Packed(2, 1, 1, {0x40, 9, 9, 9}));
    BITMAP info{};
    GetObjectA(bitmap, sizeof(info), &info);
    EXPECT_EQ(info.bmBitsPixel, 32);
    DeleteObject(bitmap);
}

TEST(Dib, RefusesWhatItCantRead) {
    const auto before = liveObjects();
    const Packed good(1, 1, 8, {0, 0, 0, 0});
    const auto refused = [&good](auto change) {
        Packed packed = good;
        change(packed.head);
        return !make(packed);
    };
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biWidth = 0; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biWidth = -1; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biHeight = 0; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biWidth = 0x7FFFFFFF; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biHeight = INT32_MIN; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biBitCount = 16; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biCompression = 1; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biClrUsed = 257; }));
    EXPECT_TRUE(refused([](BITMAPINFOHEADER& head) { head.biSize = 12; }));
    EXPECT_FALSE(CreateDIBitmap(nullptr, &good.head, CBM_INIT, good.rows.data(), &good.head, 0));
    HDC dc = CreateCompatibleDC(nullptr);
    EXPECT_FALSE(CreateDIBitmap(dc, &good.head, CBM_INIT, nullptr, &good.head, 0));
    EXPECT_FALSE(CreateDIBitmap(dc, &good.head, 0, good.rows.data(), &good.head, 0));
    DeleteDC(dc);
    EXPECT_EQ(liveObjects(), before);
}

TEST(LoadBitmap, FindsAResourceWhateverTheCase) {
    const HINSTANCE program = GetModuleHandleA(nullptr);
    for (const char* name : {"bubleft", "BubLeft"}) {
        HBITMAP bitmap = LoadBitmapA(program, name);
        BITMAP info{};
        GetObjectA(bitmap, sizeof(info), &info);
        EXPECT_EQ(info.bmWidth, 160) << name;
        EXPECT_EQ(info.bmHeight, 95);
        EXPECT_EQ(info.bmBitsPixel, 32);
        DeleteObject(bitmap);
    }
    EXPECT_FALSE(LoadBitmapA(program, "no such bitmap"));
}
