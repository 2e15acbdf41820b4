#include "resources/art/walk.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <numbers>

namespace art {

namespace {

constexpr std::size_t LoopPictures = 7;
// How far he gets from one picture to the next.
constexpr double Advance = 18;
constexpr double BodyX = 60;
// Where the ball of a foot is half-way through its time on the ground, counted from the body.
constexpr double BallForward = 8.5;
constexpr Point AnkleFromBall = {-13, -6};
constexpr double HeelFromBall = 18;
// Legs and arms keep their length, a pixel more or less, from picture to picture.
constexpr double LegLength = 43.5;
constexpr double UpperArmLength = 16;
constexpr double LowerArmLength = 15;

// A foot in one picture of the loop.
struct Step {
    // How far the ball of the foot is ahead of the middle of its way on the ground.
    double along;
    // How far the ball is above the ground.
    double lift;
    // How far the heel is turned up, in degrees; below 0 the toe is up.
    double heelUp;
};

// One picture of the loop.
struct Phase {
    Step far;
    Step near;
    // How far the body is above its middle height. Only by even steps, so that the chequered skin
    // stays the same from picture to picture.
    double rise;
    // Where the arms are, from -1 behind him to 1 before him.
    double farArm;
    double nearArm;
    // How far the tip of the cap flies up, in degrees.
    double cap;
};

// Seven pictures are three and a half for each step: the near foot comes down in picture 2, the
// far one half-way from 5 to 6. A standing foot goes back as fast as he gets on. The body is lowest
// after a foot has come down, on a bent knee, and highest before the next does; the bobble is
// highest a picture after the head.
constexpr std::array<Phase, LoopPictures> Loop = {{
    {{-29, 5, 56}, {1.5 * Advance, 0, -20}, -1, 0.95, -1, 28},
    {{-19, 8, 50}, {0.5 * Advance, 0, 0}, -3, 0.5, -0.65, 20},
    {{10, 6, 2}, {-0.5 * Advance, 0, 6}, 1, -0.85, 0.25, 16},
    {{34, 2, -20}, {-1.5 * Advance, 0, 40}, -1, -1, 0.85, 28},
    {{1 * Advance, 0, 0}, {-33, 7, 60}, -3, -0.85, 0.9, 20},
    {{0 * Advance, 0, 0}, {7, 5, 10}, 1, 0.45, -0.42, 10},
    {{-1 * Advance, 0, 22}, {23, 5, -10}, 1, 0.85, -0.8, 20},
}};

Leg stepping(const Step& step, double size) {
    Leg leg;
    leg.angle = size * step.heelUp;
    const Point ball = {BodyX + BallForward + size * step.along, Ground - size * step.lift};
    // With the toe up he stands on the heel, otherwise on the ball.
    const Point heel = ball - Point{HeelFromBall, 0};
    leg.ankle = leg.angle < 0 ? heel + turned(AnkleFromBall + Point{HeelFromBall, 0}, leg.angle)
                              : ball + turned(AnkleFromBall, leg.angle);
    if (leg.angle > 0) {
        // The round tip of the shoe would dip below the ground.
        leg.ankle.y -= 1.2 * std::sin(leg.angle * std::numbers::pi / 180);
    }
    leg.bend = -1;
    return leg;
}

// The arm bends more before him than behind.
Arm swinging(Point shoulder, double swing) {
    const double upper = 2 + (38 - 8 * swing) * swing;
    const double lower = 20 + (45 - 7 * swing) * swing;
    Arm arm;
    arm.wrist =
        shoulder + turned({0, UpperArmLength}, -upper) + turned({0, LowerArmLength}, -lower);
    arm.angle = 90 - lower;
    arm.slack = (UpperArmLength + LowerArmLength) / distance(shoulder, arm.wrist) - 1;
    arm.bend = 1;
    arm.thumb = -1;
    return arm;
}

void placeHead(Head& head, const Phase& phase, double rise) {
    head.eyeCell = {BodyX + 1, std::round(17 - rise)};
    head.mouthCell = {BodyX + 5, std::round(34 - rise)};
    head.turn = 1.5;
    head.capSwing = phase.cap;
}

Phase phaseOf(int number) {
    if (number > 1) {
        return Loop[static_cast<std::size_t>(number - 2)];
    }
    // The first step is so small that the far foot is still on the ground.
    Phase phase = Loop[0];
    phase.far = {-1.5 * Advance, 0, 40};
    phase.rise = 1;
    return phase;
}

} // namespace

Figure walkingRight(int number) {
    const Phase phase = phaseOf(number);
    const double size = number == 1 ? 0.5 : 1;
    Figure figure;
    figure.turn = 1;
    figure.pelvis = {BodyX, 82 - phase.rise};
    figure.neck = {BodyX + 4, 50 - phase.rise};
    figure.twist = size * (phase.nearArm - phase.farArm);
    placeHead(figure.head, phase, phase.rise);
    figure.legs = {stepping(phase.far, size), stepping(phase.near, size)};
    figure.arms = {swinging(shoulder(figure, 0), size * phase.farArm),
                   swinging(shoulder(figure, 1), size * phase.nearArm)};
    figure.arms[0].behind = true;
    for (std::size_t which = 0; which < 2; ++which) {
        Leg& leg = figure.legs[which];
        leg.slack = std::max(0.004, LegLength / distance(hip(figure, which), leg.ankle) - 1);
    }
    return figure;
}

} // namespace art
