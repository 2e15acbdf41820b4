#include "resources/art/hand.h"

#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <utility>
#include <vector>

namespace art {

namespace {

using Outlines = std::vector<Outline>;

struct Glove {
    Outlines outside;
    // Lines between the fingers.
    Outlines creases;
};

Outline crease(Point from, Point to) {
    return bone(from, to, 0.5, 0.5);
}

// A glove at the origin with its fingers to the right and the thumb below.
Glove glove(Grip grip) {
    switch (grip) {
    case Grip::Relaxed:
        return {{ellipse({5, -0.3}, 5.4, 5), bone({7, -2}, {10.5, -1.5}, 3, 2.8),
                 bone({7, 1}, {9.5, 1.5}, 2.8, 2.6), bone({3, 2.5}, {7.5, 6.2}, 2.3, 2)},
                {crease({9.5, -0.2}, {12, -0.2})}};
    case Grip::Open:
        return {{ellipse({5, 0}, 5.6, 5.4), bone({6.5, -2.8}, {11.5, -7}, 2.5, 2.3),
                 bone({8, 0}, {14.5, -1}, 2.5, 2.3), bone({6.5, 2.2}, {12.5, 5}, 2.5, 2.3),
                 bone({3.5, 3}, {3.5, 9.5}, 2.4, 2.2)},
                {}};
    case Grip::Pointing:
        return {{ellipse({5.2, 0.3}, 5.6, 5.4), bone({7, -2.4}, {17, -2.8}, 2.5, 2.2),
                 bone({3.5, 3}, {8.5, 5.5}, 2.4, 2.2)},
                {crease({8, 0.4}, {10, 0.4})}};
    case Grip::Fist:
        return {{ellipse({5.2, 0}, 5.8, 5.6), bone({3.5, 3.5}, {8, 4.5}, 2.4, 2.2)},
                {crease({8, -1.6}, {10.4, -1.6}), crease({8, 1.2}, {10.4, 1.2})}};
    case Grip::Flat:
        return {
            {ellipse({5, 0}, 5.4, 5.4), bone({7, -3}, {12.5, -3.2}, 2.4, 2.2),
             bone({7, 0}, {14.5, 0}, 2.5, 2.3), bone({7, 3}, {12.5, 3.4}, 2.4, 2.2)},
            {crease({9, -1.6}, {13, -1.7}), crease({9, 1.6}, {13, 1.7}), crease({4, 3}, {7.5, 4})}};
    case Grip::Screen:
        return {{ellipse({5, 0}, 5.4, 4.6), bone({6, -1.6}, {15, -1}, 2.8, 2.4),
                 bone({6, 1}, {13, 1.4}, 2.8, 2.2), bone({3.5, 2.5}, {7.5, 5.4}, 2.2, 1.9)},
                {}};
    }
    return {};
}

Outlines placed(Outlines outlines, Point at, double degrees, double flip) {
    for (Outline& outline : outlines) {
        for (Point& point : outline) {
            point = at + turned({point.x, point.y * flip}, degrees);
        }
    }
    return outlines;
}

} // namespace

void paintHand(Picture& picture, Grip grip, Point wrist, double angle, int thumb) {
    Glove hand = glove(grip);
    // The shade of a broad hand would take all of a single finger.
    const int shadow = grip == Grip::Pointing ? 1 : 2;
    const Part outside = {placed(std::move(hand.outside), wrist, angle, thumb), Linen, LinenShade,
                          shadow};
    const Mask inside = paintOutlined(picture, outside, Line);
    if (!hand.creases.empty()) {
        const Part creases = {placed(std::move(hand.creases), wrist, angle, thumb), Line, Line, 0};
        paintWithin(picture, creases, inside);
    }
}

} // namespace art
