#pragma once

#include "resources/art/hand.h"
#include "resources/art/head.h"
#include "resources/art/outline.h"
#include "resources/art/picture.h"

#include <array>
#include <cstddef>
#include <optional>

namespace art {

constexpr int FigureSize = 130;
// The row on which the soles stand: the first that a flat shoe leaves free.
constexpr double Ground = 127;

// An arm is given by its hand; the elbow follows.
struct Arm {
    Point wrist;
    // Where the fingers point, in degrees clockwise from the right.
    double angle = 90;
    Grip grip = Grip::Relaxed;
    // 1 or -1: to which side the elbow bends, and on which side of the hand the thumb sits.
    int bend = 1;
    int thumb = 1;
    // Painted before the trunk instead of after the head.
    bool behind = false;
    // How much longer the arm looks than the way from shoulder to wrist, as a share of it.
    double slack = 1;
    // Where it bends, for an arm that the body's turn shortens otherwise.
    std::optional<Point> elbow = std::nullopt;
};

// A leg is given by its ankle, which is six pixels above the sole; the knee follows.
struct Leg {
    Point ankle;
    // Turns the shoe about the ankle, positive with the toe down for a shoe that points right.
    double angle = 0;
    // 1: the toe points right, -1: left. Its size tells how long the shoe looks from here.
    double toe = 1;
    int bend = 1;
    // How much longer the leg looks than the way from hip to ankle, as a share of it.
    double slack = 0.01;
};

// One picture of him: where everything is, seen by somebody who looks at the picture. The first arm
// and leg is the one on the left in a front view, and the far one in a side view.
struct Figure {
    Head head;
    Point neck;
    Point pelvis;
    // 0 seen from the front, 1 from the side, looking right.
    double turn = 0;
    double shoulderLift = 0;
    // From the side, how far the near shoulder is ahead of its place and the far one behind.
    double twist = 0;
    std::array<Arm, 2> arms;
    std::array<Leg, 2> legs;
};

// Where an arm begins and a leg begins.
Point shoulder(const Figure& figure, std::size_t which);
Point hip(const Figure& figure, std::size_t which);

// The figure turned to the other side, for a picture in the same light.
Figure mirrored(const Figure& figure);

Picture drawFigure(const Figure& figure);

} // namespace art
