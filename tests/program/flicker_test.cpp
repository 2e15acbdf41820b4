// A walk across the real screen, grabbed at every step: each grab must be one finished picture, the
// figure over the backdrop and nothing else.
#include "tests/program/bitmaps.h"
#include "tests/program/ground.h"

#include <algorithm>
#include <map>
#include <optional>

#include <gtest/gtest.h>

namespace {

using ground::Grab;
using ground::Ground;
using ground::Picture;

struct Box {
    int left;
    int top;
    int right;
    int bottom;
};

/// The bounds of the pixels of which `differs` is true; nothing if there are none.
template <class Differs>
std::optional<Box> boundsOf(int width, int height, Differs differs) {
    std::optional<Box> box;
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            if (differs(x, y)) {
                box = box ? Box{std::min(box->left, x), box->top, std::max(box->right, x), y}
                          : Box{x, y, x, y};
            }
        }
    }
    return box;
}

/// Whether the grab is the background with the picture at (left, top), within the changed box.
bool isComposed(const Grab& grab, const Grab& background, const Box& changed,
                const Picture& picture, int left, int top) {
    for (int y = changed.top; y <= changed.bottom; ++y) {
        for (int x = changed.left; x <= changed.right; ++x) {
            const int px = x - left;
            const int py = y - top;
            const bool inside = px >= 0 && py >= 0 && px < picture.width && py < picture.height;
            const std::uint32_t own = inside ? picture.at(px, py) : 0;
            if (grab.at(x, y) != (own == 0 ? background.at(x, y) : own)) {
                return false;
            }
        }
    }
    return true;
}

struct Found {
    std::string name;
    int left;
};

/// The picture and the place that explain all that the grab has beyond the background. A pixel of
/// the figure may have the background's colour, so that places nearby are tried as well.
std::optional<Found> explain(const Grab& grab, const Grab& background, const Box& changed,
                             const std::vector<Picture>& pictures) {
    constexpr int slack = 3;
    for (const Picture& picture : pictures) {
        const Box figure = *boundsOf(picture.width, picture.height,
                                     [&](int x, int y) { return picture.at(x, y) != 0; });
        const int left =
            changed.left > 0 ? changed.left - figure.left : changed.right - figure.right;
        const int top = changed.bottom < grab.height - 1 ? changed.bottom - figure.bottom
                                                         : changed.top - figure.top;
        for (int dy = -slack; dy <= slack; ++dy) {
            for (int dx = -slack; dx <= slack; ++dx) {
                if (isComposed(grab, background, changed, picture, left + dx, top + dy)) {
                    return Found{picture.name, left + dx};
                }
            }
        }
    }
    return std::nullopt;
}

TEST(Walk, ShowsFinishedPicturesOnly) {
    const Ground ground(1280, 1024); // on which the whole of him shows on his way in
    std::filesystem::copy_file(DORBO_SOURCE_DIR "/toons/intro.zkt", ground.toons() / "intro.zkt");
    const Picture tile = ground::loadPicture("bg01");
    auto saver = ground.start({"S"});
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab().at(0, 0) == tile.at(0, 0); }));
    const Grab title = ground.grab();
    Grab background;
    ASSERT_TRUE(ground::waitFor([&] {
        background = ground.grab();
        return background != title && background.at(0, 0) != 0; // not the blank stage in between
    }));

    // The show begins with him off the stage and comes to its first rest in a pose.
    const std::vector<Picture> pictures = ground::characterPictures();
    std::vector<Found> steps;
    Grab shown = background;
    while (steps.empty() || steps.back().name.rfind("pose", 0) != 0) {
        Grab next;
        ASSERT_TRUE(ground::waitFor([&] { return (next = ground.grab()) != shown; }));
        shown = next;
        const auto changed = boundsOf(shown.width, shown.height, [&](int x, int y) {
            return shown.at(x, y) != background.at(x, y);
        });
        ASSERT_TRUE(changed);
        const auto found = explain(shown, background, *changed, pictures);
        ASSERT_TRUE(found) << "no finished picture after " << steps.size() << " steps; changed at "
                           << changed->left << "," << changed->top << " to " << changed->right
                           << "," << changed->bottom;
        steps.push_back(*found);
    }
    ASSERT_GE(steps.size(), 8U);
    const int stride = steps[1].left - steps[0].left;
    EXPECT_NE(stride, 0);
    for (std::size_t i = 1; i < steps.size(); ++i) {
        const int moved = steps[i].left - steps[i - 1].left;
        EXPECT_TRUE(moved == stride || (moved == 0 && steps[i].name.rfind("pose", 0) == 0))
            << "from " << steps[i - 1].name << " to " << steps[i].name << " by " << moved;
    }
    ground.press("space");
    EXPECT_EQ(saver.exitCode(), 0);
}

} // namespace
