// A walk across the real screen, grabbed at every step: each grab must be one finished picture, the
// figure over the backdrop and nothing else.
#include "tests/program/ground.h"

#include <algorithm>
#include <map>
#include <optional>

#include <QPainter>

#include <gtest/gtest.h>

namespace {

using ground::Ground;

/// The bounds of the pixels in which two pictures of one size differ; empty if there are none.
QRect changedBox(const QImage& one, const QImage& other) {
    int left = one.width();
    int top = one.height();
    int right = -1;
    int bottom = -1;
    for (int y = 0; y < one.height(); ++y) {
        for (int x = 0; x < one.width(); ++x) {
            if (one.pixel(x, y) != other.pixel(x, y)) {
                left = std::min(left, x);
                top = std::min(top, y);
                right = std::max(right, x);
                bottom = y;
            }
        }
    }
    return {QPoint(left, top), QPoint(right, bottom)};
}

struct Figure {
    QImage picture; // see-through where the file is black
    QRect bounds;   // of the rest
};

Figure loadFigure(const std::string& name) {
    QImage picture = ground::loadPicture(name);
    QImage nothing(picture.size(), picture.format());
    nothing.fill(Qt::black);
    const QRect bounds = changedBox(picture, nothing);
    picture.setAlphaChannel(picture.createMaskFromColor(qRgb(0, 0, 0), Qt::MaskOutColor));
    return {picture, bounds};
}

/// Whether the grab is the background with the picture at `place`, within the changed box.
bool isComposed(const QImage& grab, const QImage& background, const QRect& changed,
                const QImage& picture, QPoint place) {
    QImage composed = background.copy(changed);
    QPainter(&composed).drawImage(place - changed.topLeft(), picture);
    return composed == grab.copy(changed);
}

struct Found {
    std::string name;
    int left;
};

/// All 28 of the character, by name.
std::map<std::string, Figure> loadFigures() {
    std::vector<std::string> names{"fdltn1", "fdltn2", "fdrtn1", "fdrtn2"};
    for (int i = 1; i <= 8; ++i) {
        for (const char* row : {"fdl2r", "fdr2l", "pose0"}) {
            names.push_back(row + std::to_string(i));
        }
    }
    std::map<std::string, Figure> figures;
    for (const std::string& name : names) {
        figures[name] = loadFigure(name);
    }
    return figures;
}

/// The picture and the place that explain all that the grab has beyond the background. A pixel of
/// the figure may have the background's colour, so that places nearby are tried as well.
std::optional<Found> explain(const QImage& grab, const QImage& background, const QRect& changed,
                             const std::map<std::string, Figure>& figures) {
    constexpr int slack = 3;
    for (const auto& [name, figure] : figures) {
        const auto& [picture, bounds] = figure;
        const int left =
            changed.left() > 0 ? changed.left() - bounds.left() : changed.right() - bounds.right();
        const int top = changed.bottom() < grab.height() - 1 ? changed.bottom() - bounds.bottom()
                                                             : changed.top() - bounds.top();
        for (int dy = -slack; dy <= slack; ++dy) {
            for (int dx = -slack; dx <= slack; ++dx) {
                if (isComposed(grab, background, changed, picture, {left + dx, top + dy})) {
                    return Found{name, left + dx};
                }
            }
        }
    }
    return std::nullopt;
}

TEST(Walk, ShowsFinishedPicturesOnly) {
    const Ground ground(1280, 1024); // on which the whole of him shows on his way in
    std::filesystem::copy_file(DORBO_SOURCE_DIR "/toons/intro.zkt", ground.toons() / "intro.zkt");
    const QImage tile = ground::loadPicture("bg01");
    auto saver = ground.start({"S"});
    ASSERT_TRUE(ground::waitFor([&] { return ground.grab().pixel(0, 0) == tile.pixel(0, 0); }));
    const QImage title = ground.grab();
    QImage background;
    ASSERT_TRUE(ground::waitFor([&] {
        background = ground.grab();
        return background != title && background.pixel(0, 0) != qRgb(0, 0, 0); // nor blank
    }));

    // The show begins with him off the stage and comes to its first rest in a pose.
    const auto figures = loadFigures();
    std::vector<Found> steps;
    QImage shown = background;
    while (steps.empty() || steps.back().name.rfind("pose", 0) != 0) {
        QImage next;
        ASSERT_TRUE(ground::waitFor([&] { return (next = ground.grab()) != shown; }));
        shown = next;
        const QRect changed = changedBox(shown, background);
        const auto found = explain(shown, background, changed, figures);
        ASSERT_TRUE(found) << "no finished picture after " << steps.size() << " steps; changed at "
                           << changed.left() << "," << changed.top() << " to " << changed.right()
                           << "," << changed.bottom();
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
