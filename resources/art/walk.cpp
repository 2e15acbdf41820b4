#include "resources/art/walk.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace art {

namespace {

constexpr double LoopPictures = 7;
// How far he gets from one picture to the next.
constexpr double Advance = 18;
// A foot is on the ground for half of the loop and goes back as fast as he goes on.
constexpr double Stride = Advance * LoopPictures / 2;
constexpr double BodyX = 60;
constexpr double BallForward = 7;
constexpr Point AnkleFromBall = {-13, -6};
constexpr double HeelFromBall = 18;

double wave(double phase) {
    return std::sin(2 * std::numbers::pi * phase);
}

double smooth(double t) {
    return t * t * (3 - 2 * t);
}

double fraction(double phase) {
    return phase - std::floor(phase);
}

// How far the heel is off the ground, as a turn of the shoe in degrees; below 0 the toe is up.
double roll(double p) {
    if (p < 0.07) {
        return -18;
    }
    if (p < 0.3) {
        return 0;
    }
    if (p < 0.5) {
        return 42 * (p - 0.3) / 0.2;
    }
    const double air = (p - 0.5) * 2;
    return 42 + 22 * std::sin(std::numbers::pi * std::min(1.0, air * 1.6)) - 64 * air;
}

// The foot is led by its ball, on which it stands until the toe leaves the ground.
Leg stepping(double phase, double size) {
    const double p = fraction(phase);
    const double air = std::max(0.0, (p - 0.5) * 2);
    const double along = p < 0.5 ? Stride / 2 - Stride * 2 * p : Stride * smooth(air) - Stride / 2;
    const Point ball = {BodyX + BallForward + size * along,
                        Ground - size * 8 * std::sin(std::numbers::pi * air)};
    Leg leg;
    leg.angle = size * roll(p);
    leg.ankle = ball + turned(AnkleFromBall, leg.angle);
    if (leg.angle > 0) {
        // The round tip of the shoe would dip below the ground.
        leg.ankle.y -= 1.2 * std::sin(leg.angle * std::numbers::pi / 180);
    }
    if (leg.angle < 0) {
        // With the toe up the heel is lowest. It comes down to the ground, not below.
        const double dip = HeelFromBall * std::sin(-leg.angle * std::numbers::pi / 180);
        leg.ankle.y -= std::max(0.0, dip - (Ground - ball.y));
    }
    leg.bend = -1;
    leg.slack = 1;
    return leg;
}

Arm swinging(double phase, const Figure& figure, double size) {
    const double swing = size * 42 * wave(phase + 0.25);
    Arm arm;
    arm.wrist = figure.neck + Point{0, 7} + turned({0, 30}, -swing);
    arm.angle = 80 - swing * 1.2;
    arm.bend = 1;
    arm.thumb = -1;
    return arm;
}

} // namespace

Figure walkingRight(int number) {
    const double phase = (number - 2) / LoopPictures;
    const double size = number == 1 ? 0.5 : 1;
    Figure figure;
    // Lowest just after a contact, highest when one leg passes the other.
    const double rise = 1.4 * std::cos(4 * std::numbers::pi * (phase - 0.27));
    figure.turn = 1;
    figure.pelvis = {BodyX, 82 - rise};
    figure.neck = {BodyX + 3, 50 - rise};
    figure.head.eyeCell = {BodyX + 1, std::round(17 - rise)};
    figure.head.mouthCell = {BodyX + 5, std::round(34 - rise)};
    figure.head.turn = 1.5;
    figure.head.capSwing = 22 + 14 * wave(2 * phase - 0.1);
    figure.tails = 6 + 4 * wave(2 * phase - 0.2);
    figure.legs = {stepping(phase + 0.5, size), stepping(phase, size)};
    figure.arms = {swinging(phase, figure, size), swinging(phase + 0.5, figure, size)};
    figure.arms[0].behind = true;
    return figure;
}

} // namespace art
