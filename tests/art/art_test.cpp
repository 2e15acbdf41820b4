// The pictures round him: what the program takes for granted about them, and that the drawing
// program still draws all of its files.

#include "resources/art/gallery.h"
#include "resources/art/icons.h"
#include "tests/art/bitmap.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <gtest/gtest.h>
#include <iterator>
#include <png.h>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

namespace {

std::vector<Bitmap> tiles() {
    std::vector<Bitmap> all = series("bg0", 9);
    all.push_back(load("bg10"));
    return all;
}

/// An icon, with black for the pixels that aren't solid.
Bitmap loadIcon(const std::string& name, int size) {
    const Bytes bytes = readFile("icons/" + name + std::to_string(size) + ".png");
    png_image png{};
    png.version = PNG_IMAGE_VERSION;
    EXPECT_NE(png_image_begin_read_from_memory(&png, bytes.data(), bytes.size()), 0);
    png.format = PNG_FORMAT_RGBA;
    Bytes pixels(PNG_IMAGE_SIZE(png));
    EXPECT_NE(png_image_finish_read(&png, nullptr, pixels.data(), 0, nullptr), 0) << png.message;
    EXPECT_EQ(png.warning_or_error, 0U) << png.message;
    Bitmap icon{name + std::to_string(size),
                static_cast<int>(png.width),
                static_cast<int>(png.height),
                32,
                {},
                {}};
    for (std::size_t at = 0; at < pixels.size(); at += 4) {
        const std::uint32_t colour = pixels[at] * 65536U + pixels[at + 1] * 256U + pixels[at + 2];
        icon.pixels.push_back(pixels[at + 3] == 255 ? colour : Black);
        if (size <= 32) {
            EXPECT_EQ(pixels[at + 3] % 255, 0) << "solid or not there";
        }
    }
    return icon;
}

int brightness(std::uint32_t colour) {
    return static_cast<int>(((colour >> 16U) & 255U) * 3 + ((colour >> 8U) & 255U) * 6 +
                            (colour & 255U)) /
           10;
}

/// How much two columns, or rows, of a tile differ in all.
int step(const Bitmap& tile, int from, int to, bool rows) {
    int sum = 0;
    for (int i = 0; i < tile.width; ++i) {
        const auto a = rows ? tile.at(i, from) : tile.at(from, i);
        const auto b = rows ? tile.at(i, to) : tile.at(to, i);
        sum += std::abs(brightness(a) - brightness(b));
    }
    return sum;
}

const std::vector<std::uint32_t> sixteenColours = {
    0x000000, 0x800000, 0x008000, 0x808000, 0x000080, 0x800080, 0x008080, 0x808080,
    0xC0C0C0, 0xFF0000, 0x00FF00, 0xFFFF00, 0x0000FF, 0xFF00FF, 0x00FFFF, 0xFFFFFF};

} // namespace

TEST(Art, FilesHaveTheFormThatTheProgramReadsAndAreStillDrawnSo) {
    const std::tuple<std::vector<Bitmap>, int, int> kinds[] = {
        {figures(), 130, 130},
        {series("bg0", 1), 135, 135},
        {{load("bg02"), load("bg04"), load("bg06"), load("bg08")}, 96, 96},
        {{load("bg03"), load("bg05"), load("bg07"), load("bg09"), load("bg10")}, 80, 80},
        {{load("bubleft"), load("bubright")}, 160, 95},
        {{load("expresns")}, 54, 87},
        {{load("sysbuts")}, 44, 11},
    };

    std::size_t count = 0;
    for (const auto& [bitmaps, width, height] : kinds) {
        for (const Bitmap& bitmap : bitmaps) {
            SCOPED_TRACE(bitmap.name);
            const bool tile = bitmap.name.starts_with("bg") && bitmap.name != "bg01";
            const Bytes bytes = readBitmap(bitmap.name);
            EXPECT_EQ(std::string(bytes.begin(), bytes.begin() + 2), "BM");
            EXPECT_EQ(number(bytes, 2), bytes.size());
            EXPECT_EQ(number(bytes, 14), 40U);
            EXPECT_EQ(number(bytes, 26), 1U + bitmap.bits * 65536U);
            EXPECT_EQ(number(bytes, 30), 0U);
            EXPECT_EQ(bitmap.width, width);
            EXPECT_EQ(bitmap.height, height);
            EXPECT_EQ(bitmap.bits, tile ? 8U : 4U);
            EXPECT_EQ(bitmap.colours.size(), tile ? 256U : 16U);
            EXPECT_EQ(number(bytes, 46), bitmap.name > "bg06" && tile ? 256U : 0U);
            EXPECT_TRUE(tile || bitmap.colours == sixteenColours) << "in their fixed order";
            ++count;
        }
    }
    EXPECT_EQ(count, 42U);
    const auto gallery = art::drawGallery();
    EXPECT_EQ(gallery.size(), count + 19) << "and the icons and the pointer";
    for (const art::Exhibit& exhibit : gallery) {
        EXPECT_TRUE(exhibit.bytes == readFile(exhibit.file)) << exhibit.file;
    }
}

TEST(Art, ButtonsHaveTheirPicturesWhereTheyAreCopiedFrom) {
    const Bitmap sheet = load("sysbuts");
    constexpr std::uint32_t Grey = 0xC0C0C0;
    const std::tuple<const char*, std::uint32_t, int, int> cells[] = {
        {"bar", Black, 0, 11}, {"cross", Black, 11, 22}, {"walk", 0x000080, 20, 44}};

    int drawn = 0;
    for (const auto& [name, colour, left, right] : cells) {
        SCOPED_TRACE(name);
        int sum = 0;
        int count = 0;
        for (int i = 0; i < (right - left) * 11; ++i) {
            const int x = i % (right - left);
            const int y = i / (right - left);
            if (sheet.at(left + x, y) != Grey) {
                EXPECT_EQ(sheet.at(left + x, y), colour);
                EXPECT_TRUE(x < 10 || right == 44) << "seen on a pressed button";
                EXPECT_LT(y, 10) << "seen on a pressed button";
                sum += x;
                ++count;
            }
        }
        ASSERT_GT(count, 0);
        EXPECT_NEAR(2.0 * sum / count + 1, right == 44 ? 28 : 11, 1) << "in the middle";
        drawn += count;
    }
    EXPECT_EQ(std::ranges::count(sheet.pixels, Grey), 44 * 11 - drawn) << "none counted twice";
}

TEST(Art, IconsFillTheirSquareAndTheSmallOnesKeepToTheSixteenColours) {
    std::vector<int> sizes(std::begin(art::SmallIcons), std::end(art::SmallIcons));
    sizes.insert(sizes.end(), std::begin(art::LargeIcons), std::end(art::LargeIcons));
    EXPECT_EQ(sizes, (std::vector<int>{16, 22, 24, 32, 48, 64, 128, 256}));
    for (std::size_t i = 0; i < 2 * sizes.size(); ++i) {
        const int size = sizes[i / 2];
        const Bitmap icon = loadIcon(i % 2 == 0 ? "" : "toon-", size);
        SCOPED_TRACE(icon.name);
        ASSERT_EQ(icon.width, size);
        ASSERT_EQ(icon.height, size);
        EXPECT_EQ(smallestHole(icon), icon.pixels.size());
        EXPECT_EQ(icon.at(0, 0) | icon.at(size - 1, 0) | icon.at(0, size - 1), Black);
        const auto solid =
            icon.pixels.size() - static_cast<std::size_t>(std::ranges::count(icon.pixels, Black));
        EXPECT_GE(solid * 2, icon.pixels.size());
        for (const std::uint32_t pixel : icon.pixels) {
            ASSERT_TRUE(size > 32 || std::ranges::count(sixteenColours, pixel) == 1) << pixel;
        }
    }
}

TEST(Art, TargetIsARingAndADotThatShowsOnAnyGround) {
    const Bytes cursor = readFile("cursors/target.cur");
    ASSERT_EQ(cursor.size(), 326U);
    EXPECT_EQ(number(cursor, 2), 2U + 65536U) << "one picture, a cursor";
    EXPECT_EQ(cursor[6] * 256 + cursor[7], 32 * 256 + 32);
    EXPECT_EQ(cursor[10] * 256 + cursor[12], 16 * 256 + 15) << "the hot spot";
    // A row through the hot spot, by the two bits of each pixel.
    std::string row;
    for (unsigned x = 0; x < 32; ++x) {
        const std::size_t at = 70 + (31 - 15) * 4 + x / 8;
        const unsigned bit = 7 - x % 8;
        const bool white = (cursor.at(at) >> bit & 1) != 0;
        const bool clear = (cursor.at(at + 128) >> bit & 1) != 0;
        row += white ? 'W' : clear ? '.' : 'B';
    }
    EXPECT_EQ(row, ".....WBBW.....WBBBW.....WBBW....");
}

TEST(Art, BubblesAreWhiteForTheirTextAndHaveTheirTailsFiftyRowsDown) {
    for (const auto& [name, text, edge] : {std::tuple{"bubleft", 30, 0}, {"bubright", 10, 159}}) {
        const Bitmap bubble = load(name);
        for (int y = 0; y < 95; ++y) {
            const bool tail = bubble.at(edge, y) != Black;
            EXPECT_TRUE(tail ? std::abs(y - 50) <= 2 : y != 50) << name << " " << y;
            for (int x = text; y >= 26 && y < 94 && x < text + 120; ++x) {
                ASSERT_EQ(bubble.at(x, y), White) << name << " " << x << ", " << y;
            }
        }
        EXPECT_EQ(smallestHole(bubble), bubble.pixels.size()) << name;
    }
}

TEST(Art, TilesAreLightAndCalmAndRepeatWithoutASeam) {
    for (const Bitmap& tile : tiles()) {
        SCOPED_TRACE(tile.name);
        for (const bool rows : {false, true}) {
            int largest = 0;
            int sum = 0;
            for (int i = 0; i + 1 < tile.width; ++i) {
                largest = std::max(largest, step(tile, i, i + 1, rows));
                sum += step(tile, i, i + 1, rows);
            }
            EXPECT_LE(step(tile, tile.width - 1, 0, rows), largest * 11 / 10);
            EXPECT_LE(sum / tile.width, 7 * tile.width) << "it flickers";
        }
        const auto [darkest, lightest] = std::ranges::minmax(tile.pixels, {}, brightness);
        EXPECT_GE(brightness(darkest), 160);
        EXPECT_LE(brightness(lightest) - brightness(darkest), 64);
    }
}

TEST(Art, NoTwoTilesAreTakenForEachOther) {
    std::vector<std::vector<int>> others;
    for (const Bitmap& tile : tiles()) {
        std::vector<int> mean;
        for (const unsigned shift : {0U, 8U, 16U}) {
            int sum = 0;
            for (const std::uint32_t pixel : tile.pixels) {
                sum += static_cast<int>(pixel >> shift & 255U);
            }
            mean.push_back(sum / (tile.width * tile.height));
        }
        for (const auto& other : others) {
            EXPECT_GE(std::abs(mean[0] - other[0]) + std::abs(mean[1] - other[1]) +
                          std::abs(mean[2] - other[2]),
                      24)
                << tile.name;
        }
        others.push_back(mean);
    }
}
