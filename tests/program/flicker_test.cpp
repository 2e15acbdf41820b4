// A walk across the real screen, grabbed at every step: each grab must be one finished picture, the
// figure over the backdrop and nothing else.
#include "tests/program/ground.h"

#include <algorithm>
#include <iterator>
#include <map>
#include <optional>

#include <gtest/gtest.h>

namespace {

using ground::Ground;

const QRgb* rowOf(const QImage& image, int y) {
    return reinterpret_cast<const QRgb*>(image.constScanLine(y));
}

/// The bounds of the pixels in which two pictures of one size differ; empty if there are none.
QRect changedBox(const QImage& one, const QImage& other) {
    QRect box;
    for (int y = 0; y < one.height(); ++y) {
        const QRgb* row = rowOf(one, y);
        const QRgb* end = row + one.width();
        const auto first = std::mismatch(row, end, rowOf(other, y)).first;
        if (first != end) {
            const auto last = std::mismatch(std::reverse_iterator(end), std::reverse_iterator(row),
                                            std::reverse_iterator(rowOf(other, y) + one.width()));
            const auto left = static_cast<int>(first - row);
            const auto right = static_cast<int>(last.first.base() - row) - 1;
            box |= QRect(QPoint(left, y), QPoint(right, y));
        }
    }
    return box;
}

struct Figure {
    QImage picture; // black where it is see-through
    QRect bounds;   // of the rest
};

Figure loadFigure(const std::string& name) {
    const QImage picture = ground::loadPicture(name);
    QImage nothing(picture.size(), picture.format());
    nothing.fill(Qt::black);
    return {picture, changedBox(picture, nothing)};
}

/// Whether the grab is the background with the picture at `place`, within the changed box.
bool isComposed(const QImage& grab, const QImage& background, const QRect& changed,
                const QImage& picture, QPoint place) {
    for (int y = changed.top(); y <= changed.bottom(); ++y) {
        for (int x = changed.left(); x <= changed.right(); ++x) {
            const QPoint at = QPoint(x, y) - place;
            const bool covered = picture.valid(at) && picture.pixel(at) != qRgb(0, 0, 0);
            if (grab.pixel(x, y) != (covered ? picture.pixel(at) : background.pixel(x, y))) {
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
    std::filesystem::copy_file(DORBO_TOONS "/intro.zkt", ground.toons() / "intro.zkt");
    ground.command({"xsetroot", "-solid", "#336699"});
    const QImage bare = ground.grab();
    auto saver = ground.start({"S"});
    QImage title;
    ASSERT_TRUE(ground::waitFor([&] { return (title = ground.grab()) != bare; }));
    EXPECT_EQ(title.pixel(0, 0), ground::loadPicture("bg01").pixel(0, 0))
        << "the first that shows is a whole picture";
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
    constexpr int stride = 16; // of this walk; a grab that comes late misses some
    for (std::size_t i = 1; i < steps.size(); ++i) {
        const int moved = steps[i].left - steps[i - 1].left;
        const bool posed = steps[i].name.rfind("pose", 0) == 0;
        EXPECT_TRUE(moved % stride == 0 && moved >= (posed ? 0 : stride))
            << "from " << steps[i - 1].name << " to " << steps[i].name << " by " << moved;
    }
    ground.press("space");
    EXPECT_EQ(saver.exitCode(), 0);
}

} // namespace
