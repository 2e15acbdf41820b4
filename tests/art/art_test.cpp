// The pictures of the stage: what the program takes for granted about them, and that the drawing
// program still draws them.

#include "resources/art/gallery.h"
#include "resources/art/poses.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <cstdlib>
#include <fstream>
#include <gtest/gtest.h>
#include <iterator>
#include <set>
#include <string>
#include <utility>
#include <vector>

namespace {

using Bytes = std::vector<std::uint8_t>;

struct Bitmap {
    int width = 0;
    int height = 0;
    int bits = 0;
    std::uint32_t coloursUsed = 0;
    std::vector<std::uint32_t> colours;
    std::vector<std::uint8_t> pixels;

    std::uint32_t at(int x, int y) const {
        return colours.at(pixels.at(static_cast<std::size_t>(y * width + x)));
    }
};

constexpr std::uint32_t Black = 0;
constexpr std::uint32_t White = 0xFFFFFF;

Bytes readFile(const std::string& name) {
    std::ifstream file(std::string(DORBO_SOURCE_DIR "/resources/bitmaps/") + name + ".bmp",
                       std::ios::binary);
    return Bytes(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
}

std::uint32_t number(const Bytes& bytes, std::size_t at, int size) {
    std::uint32_t value = 0;
    for (int i = size - 1; i >= 0; --i) {
        value = value * 256 + bytes.at(at + static_cast<std::size_t>(i));
    }
    return value;
}

Bitmap load(const std::string& name) {
    const Bytes bytes = readFile(name);
    Bitmap bitmap;
    bitmap.width = static_cast<int>(number(bytes, 18, 4));
    bitmap.height = static_cast<int>(number(bytes, 22, 4));
    bitmap.bits = static_cast<int>(number(bytes, 28, 2));
    bitmap.coloursUsed = number(bytes, 46, 4);
    const std::size_t start = number(bytes, 10, 4);
    for (std::size_t at = 54; at < start; at += 4) {
        bitmap.colours.push_back(number(bytes, at, 4));
    }
    const auto row = static_cast<std::size_t>((bitmap.width * bitmap.bits + 31) / 32 * 4);
    for (int y = bitmap.height - 1; y >= 0; --y) {
        for (int x = 0; x < bitmap.width; ++x) {
            const auto bit = static_cast<std::size_t>(x * bitmap.bits);
            const int byte = bytes.at(start + static_cast<std::size_t>(y) * row + bit / 8);
            const int nibble = bit % 8 == 0 ? byte / 16 : byte % 16;
            bitmap.pixels.push_back(static_cast<std::uint8_t>(bitmap.bits == 8 ? byte : nibble));
        }
    }
    return bitmap;
}

struct Form {
    std::string name;
    int width;
    int height;
    int bits;
    std::uint32_t coloursUsed;
};

std::vector<std::string> numbered(const std::string& stem, int count) {
    std::vector<std::string> names;
    for (int i = 1; i <= count; ++i) {
        names.push_back(stem + std::to_string(i));
    }
    return names;
}

std::vector<std::string> figures() {
    std::vector<std::string> names;
    for (const auto& [stem, count] :
         {std::pair{"fdl2r", 8}, std::pair{"fdr2l", 8}, std::pair{"fdltn", 2},
          std::pair{"fdrtn", 2}, std::pair{"pose0", 8}}) {
        const auto some = numbered(stem, count);
        names.insert(names.end(), some.begin(), some.end());
    }
    return names;
}

std::vector<Form> tiles() {
    return {{"bg01", 135, 135, 4, 0}, {"bg02", 96, 96, 8, 0},   {"bg03", 80, 80, 8, 0},
            {"bg04", 96, 96, 8, 0},   {"bg05", 80, 80, 8, 0},   {"bg06", 96, 96, 8, 0},
            {"bg07", 80, 80, 8, 256}, {"bg08", 96, 96, 8, 256}, {"bg09", 80, 80, 8, 256},
            {"bg10", 80, 80, 8, 256}};
}

std::vector<Form> everything() {
    std::vector<Form> forms = tiles();
    for (const std::string& name : figures()) {
        forms.push_back({name, 130, 130, 4, 0});
    }
    forms.push_back({"bubleft", 160, 95, 4, 0});
    forms.push_back({"bubright", 160, 95, 4, 0});
    forms.push_back({"expresns", 54, 87, 4, 0});
    return forms;
}

// The sizes of the black areas that don't reach the picture's edge.
std::vector<int> enclosedBlack(const Bitmap& bitmap) {
    std::set<std::pair<int, int>> seen;
    std::vector<int> sizes;
    for (int start = 0; start < bitmap.width * bitmap.height; ++start) {
        std::vector<std::pair<int, int>> area = {{start % bitmap.width, start / bitmap.width}};
        if (bitmap.at(area[0].first, area[0].second) != Black || !seen.insert(area[0]).second) {
            continue;
        }
        bool open = false;
        for (std::size_t i = 0; i < area.size(); ++i) {
            const auto [x, y] = area[i];
            for (const auto& [dx, dy] : {std::pair{1, 0}, {-1, 0}, {0, 1}, {0, -1}}) {
                const std::pair<int, int> next = {x + dx, y + dy};
                const bool inside = next.first >= 0 && next.second >= 0 &&
                                    next.first < bitmap.width && next.second < bitmap.height;
                open = open || !inside;
                if (inside && bitmap.at(next.first, next.second) == Black &&
                    seen.insert(next).second) {
                    area.push_back(next);
                }
            }
        }
        if (!open) {
            sizes.push_back(static_cast<int>(area.size()));
        }
    }
    return sizes;
}

int lowestRow(const Bitmap& bitmap) {
    for (int i = bitmap.width * bitmap.height - 1; i >= 0; --i) {
        if (bitmap.at(i % bitmap.width, i / bitmap.width) != Black) {
            return i / bitmap.width;
        }
    }
    return -1;
}

int firstColumn(const Bitmap& bitmap, int row) {
    int x = 0;
    while (x < bitmap.width && bitmap.at(x, row) == Black) {
        ++x;
    }
    return x;
}

int differences(const Bitmap& sheet, int expression, int pose, const Bitmap& picture,
                art::Point corner) {
    int count = 0;
    for (int i = 0; i < 100; ++i) {
        const int x = i % 10;
        const int y = i / 10;
        count += sheet.at((expression - 1) * 11 + x, pose * 11 + y) !=
                 picture.at(static_cast<int>(corner.x) + x, static_cast<int>(corner.y) + y);
    }
    return count;
}

int brightness(std::uint32_t colour) {
    return static_cast<int>(((colour >> 16U) & 255U) * 3 + ((colour >> 8U) & 255U) * 6 +
                            (colour & 255U)) /
           10;
}

// How much two columns, or rows, of a tile differ in all.
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

TEST(Art, FilesHaveTheFormThatTheProgramReads) {
    ASSERT_EQ(everything().size(), 41U);
    for (const Form& form : everything()) {
        SCOPED_TRACE(form.name);
        const Bytes bytes = readFile(form.name);
        ASSERT_GT(bytes.size(), 54U);
        const Bitmap bitmap = load(form.name);
        EXPECT_EQ(bytes[0], 'B');
        EXPECT_EQ(bytes[1], 'M');
        EXPECT_EQ(number(bytes, 2, 4), bytes.size());
        EXPECT_EQ(number(bytes, 10, 4), 54U + (4U << form.bits));
        EXPECT_EQ(number(bytes, 14, 4), 40U);
        EXPECT_EQ(number(bytes, 26, 2), 1U);
        EXPECT_EQ(number(bytes, 30, 4), 0U);
        EXPECT_EQ(bitmap.width, form.width);
        EXPECT_EQ(bitmap.height, form.height);
        EXPECT_EQ(bitmap.bits, form.bits);
        EXPECT_EQ(bitmap.coloursUsed, form.coloursUsed);
    }
}

TEST(Art, SixteenColoursStandInTheirFixedOrder) {
    const std::vector<std::uint32_t> fixed = {
        0x000000, 0x800000, 0x008000, 0x808000, 0x000080, 0x800080, 0x008080, 0x808080,
        0xC0C0C0, 0xFF0000, 0x00FF00, 0xFFFF00, 0x0000FF, 0xFF00FF, 0x00FFFF, 0xFFFFFF};
    for (const Form& form : everything()) {
        if (form.bits == 4) {
            EXPECT_EQ(load(form.name).colours, fixed) << form.name;
        }
    }
}

TEST(Art, DrawingProgramStillDrawsTheseFiles) {
    const auto gallery = art::drawGallery();
    std::set<std::string> names;
    for (const art::Exhibit& exhibit : gallery) {
        names.insert(exhibit.name);
        EXPECT_TRUE(exhibit.bytes == readFile(exhibit.name)) << exhibit.name;
    }
    EXPECT_EQ(names.size(), 41U);
}

TEST(Art, FigureHasNoHoles) {
    // Between an arm and the trunk the stage may show through, but nothing as small as this.
    constexpr int SmallestGap = 13;
    for (const std::string& name : figures()) {
        const Bitmap bitmap = load(name);
        for (const int size : enclosedBlack(bitmap)) {
            EXPECT_GE(size, SmallestGap) << name;
        }
        for (const int x : {0, 129}) {
            for (const int y : {0, 129}) {
                EXPECT_EQ(bitmap.at(x, y), Black) << name;
            }
        }
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
        for (const int expression : {1, 3, 4}) {
            const int count =
                differences(sheet, expression, pose, picture, expression == 1 ? eyes : mouth);
            EXPECT_GE(count, 1) << expression;
            EXPECT_LE(count, 25) << expression;
        }
    }
}

TEST(Art, WhiteLinesPartTheFaces) {
    const Bitmap sheet = load("expresns");
    for (int y = 0; y < sheet.height; ++y) {
        for (int x = 0; x < sheet.width; ++x) {
            if (x % 11 == 10 || y % 11 == 10) {
                EXPECT_EQ(sheet.at(x, y), White) << x << ", " << y;
            }
        }
    }
}

TEST(Art, MouthCellsOfATalkAreAllDifferent) {
    const Bitmap sheet = load("expresns");
    const Bitmap picture = load("pose01");
    EXPECT_NE(differences(sheet, 3, 0, picture, art::MouthCells[0]),
              differences(sheet, 4, 0, picture, art::MouthCells[0]));
}

TEST(Art, EachPoseHasAnOutlineOfItsOwn) {
    for (int a = 1; a <= art::PoseCount; ++a) {
        for (int b = a + 1; b <= art::PoseCount; ++b) {
            const Bitmap first = load("pose0" + std::to_string(a));
            const Bitmap second = load("pose0" + std::to_string(b));
            int both = 0;
            int either = 0;
            for (int i = 0; i < 130 * 130; ++i) {
                const bool inFirst = first.at(i % 130, i / 130) != Black;
                const bool inSecond = second.at(i % 130, i / 130) != Black;
                both += inFirst && inSecond;
                either += inFirst || inSecond;
            }
            EXPECT_LT(both * 100, either * 88) << a << " and " << b;
        }
    }
}

TEST(Art, SolesStandOnOneLine) {
    for (const std::string& name : figures()) {
        EXPECT_EQ(lowestRow(load(name)), 127) << name;
    }
}

TEST(Art, FeetOnTheGroundDoNotSlide) {
    // In each of these pairs the same foot stands flat, and he gets on by 18 pixels.
    for (const auto& [before, after] : {std::pair{3, 4}, std::pair{6, 7}}) {
        const Bitmap first = load("fdl2r" + std::to_string(before));
        const Bitmap second = load("fdl2r" + std::to_string(after));
        EXPECT_NEAR(firstColumn(first, 127) - 18, firstColumn(second, 127), 1) << before;
    }
}

TEST(Art, BubbleIsWhiteWhereItsTextGoes) {
    for (const auto& [name, left] : {std::pair{"bubleft", 30}, std::pair{"bubright", 10}}) {
        const Bitmap bubble = load(name);
        // The last row is the balloon's line.
        for (int y = 26; y < 94; ++y) {
            for (int x = left; x < left + 120; ++x) {
                ASSERT_EQ(bubble.at(x, y), White) << name << " " << x << ", " << y;
            }
        }
        EXPECT_TRUE(enclosedBlack(bubble).empty()) << name;
    }
}

TEST(Art, BubbleTailsAreAtTheEdgesFiftyRowsDown) {
    const Bitmap left = load("bubleft");
    const Bitmap right = load("bubright");
    for (int y = 0; y < 95; ++y) {
        const bool tail = left.at(0, y) != Black;
        EXPECT_EQ(tail, right.at(159, y) != Black) << y;
        EXPECT_TRUE(!tail || std::abs(y - 50) <= 2) << y;
        EXPECT_TRUE(tail || y != 50);
    }
}

TEST(Art, TilesRepeatWithoutASeam) {
    for (const Form& form : tiles()) {
        const Bitmap tile = load(form.name);
        for (const bool rows : {false, true}) {
            int largest = 0;
            for (int i = 0; i + 1 < form.width; ++i) {
                largest = std::max(largest, step(tile, i, i + 1, rows));
            }
            EXPECT_LE(step(tile, form.width - 1, 0, rows), largest * 11 / 10)
                << form.name << (rows ? " top and bottom" : " left and right");
        }
    }
}

TEST(Art, TilesAreLightAndLowInContrast) {
    for (const Form& form : tiles()) {
        const Bitmap tile = load(form.name);
        int darkest = 255;
        int lightest = 0;
        for (int i = 0; i < form.width * form.height; ++i) {
            const int light = brightness(tile.at(i % form.width, i / form.width));
            darkest = std::min(darkest, light);
            lightest = std::max(lightest, light);
        }
        EXPECT_GE(darkest, 160) << form.name;
        EXPECT_LE(lightest - darkest, 64) << form.name;
    }
}
