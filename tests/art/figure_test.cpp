// The pictures of him: what the program takes for granted about them, and what a viewer would miss.

#include "resources/art/poses.h"
#include "tests/art/bitmap.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <iterator>
#include <string>
#include <tuple>
#include <vector>

namespace {

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

/// How many pixels of white cloth, gloves and collar, a bubble hides, or how many there are
/// without.
int whiteCloth(const Bitmap& figure, const Bitmap* bubble = nullptr, int left = 0) {
    constexpr int Top = 35 - 50; // the tail's tip is at the height of his mouth
    int count = 0;
    for (int i = 0; i < 130 * 129; ++i) {
        const int x = i % 129;
        const int y = i / 129;
        // Skin has every second pixel white.
        const bool cloth = figure.at(x, y) == White && figure.at(x + 1, y) == White;
        const bool inside =
            bubble != nullptr && x >= left && x < left + bubble->width && y - Top < bubble->height;
        const bool hidden = inside && bubble->at(x - left, y - Top) != Black;
        count += cloth && (bubble == nullptr || hidden);
    }
    return count;
}

} // namespace

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
    const std::tuple<int, int, bool> pairs[] = {
        {2, 3, false}, {3, 4, true}, {4, 5, true}, {6, 7, true}, {7, 8, true}};
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

TEST(Art, BubblesLeaveHisHandsFreeWhereTheyTellThePose) {
    // The bubbles beside which each pose has to be understood: on his left, on his right.
    const std::tuple<int, bool, bool> poses[] = {{2, true, true}, {3, true, true}, {4, false, true},
                                                 {5, true, true}, {6, true, true}, {7, true, true},
                                                 {8, true, false}};
    const Bitmap before = load("bubright");
    const Bitmap behind = load("bubleft");
    for (const auto& [pose, left, right] : poses) {
        SCOPED_TRACE(pose);
        const Bitmap figure = load("pose0" + std::to_string(pose));
        const int most = whiteCloth(figure) / 10;
        EXPECT_TRUE(!left || whiteCloth(figure, &before, 65 - 15 - 160) <= most);
        EXPECT_TRUE(!right || whiteCloth(figure, &behind, 65 + 15) <= most);
    }
}
