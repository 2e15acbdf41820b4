// The pictures: what the program takes for granted about them, and that the drawing program still
// draws them.

#include "resources/art/gallery.h"
#include "resources/art/icons.h"
#include "resources/art/poses.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <png.h>
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
    std::ifstream file(DORBO_SOURCE_DIR "/resources/" + name, std::ios::binary);
    return Bytes(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

Bytes readBitmap(const std::string& name) {
    return readFile("bitmaps/" + name + ".bmp");
}

std::uint32_t number(const Bytes& bytes, std::size_t at) {
    return bytes.at(at) + bytes.at(at + 1) * 256U + bytes.at(at + 2) * 65536U;
}

Bitmap load(const std::string& name) {
    const Bytes bytes = readBitmap(name);
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

/// An icon, with black for the pixels that aren't solid.
Bitmap loadIcon(int size) {
    const Bytes bytes = readFile("icons/" + std::to_string(size) + ".png");
    png_image png{};
    png.version = PNG_IMAGE_VERSION;
    EXPECT_NE(png_image_begin_read_from_memory(&png, bytes.data(), bytes.size()), 0);
    png.format = PNG_FORMAT_RGBA;
    Bytes pixels(PNG_IMAGE_SIZE(png));
    EXPECT_NE(png_image_finish_read(&png, nullptr, pixels.data(), 0, nullptr), 0) << png.message;
    EXPECT_EQ(png.warning_or_error, 0U) << png.message;
    Bitmap icon{std::to_string(size),
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

/// How many pixels of a face cell differ from the picture that it is stamped on: all, or those on
/// the cell's rim.
int differences(const Bitmap& sheet, int expression, int pose, const Bitmap& picture,
                art::Point corner, bool rimOnly = false) {
    int count = 0;
    for (int i = 0; i < 100; ++i) {
        const int x = i % 10;
        const int y = i / 10;
        const bool counts = !rimOnly || x == 0 || x == 9 || y == 0 || y == 9;
        count += counts &&
                 sheet.at((expression - 1) * 11 + x, pose * 11 + y) !=
                     picture.at(static_cast<int>(corner.x) + x, static_cast<int>(corner.y) + y);
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
    EXPECT_EQ(gallery.size(), count + 10) << "and the icons and the pointer";
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
    for (const int size : sizes) {
        SCOPED_TRACE(size);
        const Bitmap icon = loadIcon(size);
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
}

TEST(Art, AFootThatStandsStaysWhereItIsWhileHeGetsOn) {
    // Pairs of pictures in which the same foot stands, the second time as the hind one, and
    // whether its heel or its toe is on the ground in both.
    const std::tuple<int, int, bool> pairs[] = {{2, 3, false}, {3, 4, true}, {4, 5, true},
                                                {5, 6, false}, {6, 7, true}, {7, 8, true}};
    const auto sole = [](int number) {
        const Bitmap figure = load("fdl2r" + std::to_string(number));
        std::string row;
        for (int x = 0; x < figure.width; ++x) {
            row += figure.at(x, 127) == Black ? ' ' : '#';
        }
        return row;
    };
    for (const auto& [number, next, toe] : pairs) {
        SCOPED_TRACE(number);
        const std::string before = sole(number);
        const std::string after = sole(next);
        const std::size_t last = before.rfind('#');
        const std::size_t first = after.find('#');
        const int from = static_cast<int>(toe ? last : before.rfind(' ', last) + 1);
        const int to = static_cast<int>(toe ? after.find(' ', first) - 1 : first);
        EXPECT_NEAR(from - 18, to, 2);
    }
}

TEST(Art, HeWalksAndTurnsToTheLeftAsToTheRight) {
    std::vector<Bitmap> rights = series("fdl2r", 8);
    std::vector<Bitmap> lefts = series("fdr2l", 8);
    std::ranges::move(series("fdltn", 2), std::back_inserter(rights));
    std::ranges::move(series("fdrtn", 2), std::back_inserter(lefts));
    for (std::size_t number = 0; number < rights.size(); ++number) {
        int differing = 0;
        for (int i = 0; i < 130 * 130; ++i) {
            const bool his = rights[number].at(i % 130, i / 130) != Black;
            differing += his != (lefts[number].at(129 - i % 130, i / 130) != Black);
        }
        EXPECT_LT(differing, 20) << "another outline in " << lefts[number].name;
    }
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
        // Shut eyes cover all of the open ones; where he laughs, they are slits.
        EXPECT_GE(differences(sheet, 1, pose, picture, eyes), 10);
        for (const int expression : {3, 4}) {
            EXPECT_GE(differences(sheet, expression, pose, picture, mouth), 4) << expression;
            // No edge of a stamp shows on his face.
            EXPECT_EQ(differences(sheet, expression, pose, picture, mouth, true), 0) << expression;
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
