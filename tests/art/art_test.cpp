// The pictures of the stage: what the program takes for granted about them, and that the drawing
// program still draws them.

#include "resources/art/gallery.h"
#include "resources/art/poses.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <string>
#include <tuple>
#include <utility>
#include <vector>

namespace {

using Bytes = std::vector<std::uint8_t>;

constexpr std::uint32_t Black = 0;
constexpr std::uint32_t White = 0xFFFFFF;

struct Bitmap {
    std::string name;
    int width = 0;
    int height = 0;
    std::uint32_t bits = 0;
    std::vector<std::uint32_t> colours;
    std::vector<std::uint32_t> pixels; // as colours

    std::uint32_t at(int x, int y) const {
        return pixels.at(static_cast<std::size_t>(y * width + x));
    }
};

Bytes readFile(const std::string& name) {
    std::ifstream file(DORBO_SOURCE_DIR "/resources/bitmaps/" + name + ".bmp", std::ios::binary);
    return Bytes(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

std::uint32_t number(const Bytes& bytes, std::size_t at) {
    return bytes.at(at) + bytes.at(at + 1) * 256U + bytes.at(at + 2) * 65536U;
}

Bitmap load(const std::string& name) {
    const Bytes bytes = readFile(name);
    Bitmap bitmap{name,
                  static_cast<int>(number(bytes, 18)),
                  static_cast<int>(number(bytes, 22)),
                  bytes.at(28),
                  {},
                  {}};
    const std::size_t start = number(bytes, 10);
    for (std::size_t at = 54; at < start; at += 4) {
        bitmap.colours.push_back(number(bytes, at));
    }
    const auto width = static_cast<std::uint32_t>(bitmap.width);
    const std::uint32_t row = (width * bitmap.bits + 31) / 32 * 4;
    for (int y = bitmap.height - 1; y >= 0; --y) {
        for (std::uint32_t bit = 0; bit < width * bitmap.bits; bit += bitmap.bits) {
            const int byte = bytes.at(start + static_cast<std::uint32_t>(y) * row + bit / 8);
            const int nibble = bit % 8 == 0 ? byte / 16 : byte % 16;
            const int index = bitmap.bits == 8 ? byte : nibble;
            bitmap.pixels.push_back(bitmap.colours.at(static_cast<std::size_t>(index)));
        }
    }
    return bitmap;
}

std::vector<Bitmap> series(const std::string& stem, int count) {
    std::vector<Bitmap> bitmaps;
    for (int i = 1; i <= count; ++i) {
        bitmaps.push_back(load(stem + std::to_string(i)));
    }
    return bitmaps;
}

std::vector<Bitmap> figures() {
    std::vector<Bitmap> all = series("pose0", art::PoseCount);
    for (const auto& [stem, count] :
         {std::pair{"fdl2r", 8}, {"fdr2l", 8}, {"fdltn", 2}, {"fdrtn", 2}}) {
        std::ranges::move(series(stem, count), std::back_inserter(all));
    }
    return all;
}

std::vector<Bitmap> tiles() {
    std::vector<Bitmap> all = series("bg0", 9);
    all.push_back(load("bg10"));
    return all;
}

/// The size of the smallest black area that doesn't reach the picture's edge.
std::size_t smallestHole(const Bitmap& bitmap) {
    std::vector<std::uint32_t> left = bitmap.pixels;
    std::size_t smallest = left.size();
    for (int start = 0; start < std::ssize(left); ++start) {
        std::vector<int> area = {start};
        std::size_t found = 0;
        bool open = false;
        while (!area.empty()) {
            const int at = area.back();
            area.pop_back();
            if (std::exchange(left[static_cast<std::size_t>(at)], White) == Black) {
                const bool edges[] = {at % bitmap.width == 0, (at + 1) % bitmap.width == 0,
                                      at < bitmap.width, at + bitmap.width >= std::ssize(left)};
                const int steps[] = {-1, 1, -bitmap.width, bitmap.width};
                for (std::size_t i = 0; i < std::size(steps); ++i) {
                    open = open || edges[i];
                    area.push_back(edges[i] ? at : at + steps[i]);
                }
                ++found;
            }
        }
        smallest = found == 0 || open ? smallest : std::min(smallest, found);
    }
    return smallest;
}

int differences(const Bitmap& sheet, int expression, int pose, const Bitmap& picture,
                art::Point corner) {
    int count = 0;
    for (int i = 0; i < 100; ++i) {
        count +=
            sheet.at((expression - 1) * 11 + i % 10, pose * 11 + i / 10) !=
            picture.at(static_cast<int>(corner.x) + i % 10, static_cast<int>(corner.y) + i / 10);
    }
    return count;
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

} // namespace

TEST(Art, FilesHaveTheFormThatTheProgramReadsAndAreStillDrawnSo) {
    const std::vector<std::uint32_t> sixteen = {
        0x000000, 0x800000, 0x008000, 0x808000, 0x000080, 0x800080, 0x008080, 0x808080,
        0xC0C0C0, 0xFF0000, 0x00FF00, 0xFFFF00, 0x0000FF, 0xFF00FF, 0x00FFFF, 0xFFFFFF};
    const std::tuple<std::vector<Bitmap>, int, int> kinds[] = {
        {figures(), 130, 130},
        {series("bg0", 1), 135, 135},
        {{load("bg02"), load("bg04"), load("bg06"), load("bg08")}, 96, 96},
        {{load("bg03"), load("bg05"), load("bg07"), load("bg09"), load("bg10")}, 80, 80},
        {{load("bubleft"), load("bubright")}, 160, 95},
        {{load("expresns")}, 54, 87},
    };

    std::size_t count = 0;
    for (const auto& [bitmaps, width, height] : kinds) {
        for (const Bitmap& bitmap : bitmaps) {
            SCOPED_TRACE(bitmap.name);
            const bool tile = bitmap.name.starts_with("bg") && bitmap.name != "bg01";
            const Bytes bytes = readFile(bitmap.name);
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
            EXPECT_TRUE(tile || bitmap.colours == sixteen) << "in their fixed order";
            ++count;
        }
    }
    EXPECT_EQ(count, 41U);
    const auto gallery = art::drawGallery();
    EXPECT_EQ(gallery.size(), count);
    for (const art::Exhibit& exhibit : gallery) {
        EXPECT_TRUE(exhibit.bytes == readFile(exhibit.name)) << exhibit.name;
    }
}

TEST(Art, FiguresHaveNoHolesAndStandOnOneLine) {
    for (const Bitmap& figure : figures()) {
        SCOPED_TRACE(figure.name);
        // Between an arm and the trunk the stage may show through, but nothing smaller.
        EXPECT_GE(smallestHole(figure), 13U);
        EXPECT_EQ(figure.at(0, 0) | figure.at(129, 0), Black);
        const auto last = std::find_if(figure.pixels.rbegin(), figure.pixels.rend(),
                                       [](std::uint32_t pixel) { return pixel != Black; });
        EXPECT_EQ((figure.pixels.rend() - last - 1) / 130, 127) << "the row of the soles";
    }
    // In each of these pairs the same foot stands flat, and he gets on by 18 pixels.
    const auto heel = [](const std::string& name) {
        const Bitmap figure = load(name);
        const auto sole = figure.pixels.begin() + 127 * 130;
        const auto isHis = [](std::uint32_t pixel) { return pixel != Black; };
        return static_cast<int>(std::find_if(sole, sole + 130, isHis) - sole);
    };
    EXPECT_NEAR(heel("fdl2r3") - 18, heel("fdl2r4"), 1);
    EXPECT_NEAR(heel("fdl2r6") - 18, heel("fdl2r7"), 1);
}

TEST(Art, FacesFitThePoses) {
    const Bitmap sheet = load("expresns");
    for (int pose = 0; pose < art::PoseCount; ++pose) {
        SCOPED_TRACE(pose);
        const Bitmap picture = load("pose0" + std::to_string(pose + 1));
        const art::Point eyes = art::EyeCells[static_cast<std::size_t>(pose)];
        const art::Point mouth = art::MouthCells[static_cast<std::size_t>(pose)];
        EXPECT_LE(differences(sheet, 2, pose, picture, eyes), 3);
        EXPECT_LE(differences(sheet, 5, pose, picture, mouth), 3);
        for (const int expression : {1, 3, 4}) {
            const int count =
                differences(sheet, expression, pose, picture, expression == 1 ? eyes : mouth);
            EXPECT_NEAR(count, 13, 12) << expression;
        }
    }
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

TEST(Art, TilesAreLightAndRepeatWithoutASeam) {
    for (const Bitmap& tile : tiles()) {
        SCOPED_TRACE(tile.name);
        for (const bool rows : {false, true}) {
            int largest = 0;
            for (int i = 0; i + 1 < tile.width; ++i) {
                largest = std::max(largest, step(tile, i, i + 1, rows));
            }
            EXPECT_LE(step(tile, tile.width - 1, 0, rows), largest * 11 / 10);
        }
        const auto [darkest, lightest] = std::ranges::minmax(tile.pixels, {}, brightness);
        EXPECT_GE(brightness(darkest), 160);
        EXPECT_LE(brightness(lightest) - brightness(darkest), 64);
    }
}
