#include "resources/art/walk.h"

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

double wave(double phase) {
    return std::sin(2 * std::numbers::pi * phase);
}

double fraction(double phase) {
    return phase - std::floor(phase);
}

Leg stepping(double phase, double size) {
    const double p = fraction(phase);
    Leg leg;
    leg.bend = -1;
    if (p < 0.5) {
        leg.ankle = {BodyX - 4 + size * (Stride / 2 - Stride * 2 * p), Ground - 6};
        return leg;
    }
    const double air = (p - 0.5) * 2;
    const double lift = 12 * std::sin(std::numbers::pi * air);
    leg.ankle = {BodyX - 4 + size * (Stride * air - Stride / 2), Ground - 6 - size * lift};
    leg.angle =
        size * (45 * (1 - air) * std::sin(std::numbers::pi * std::sqrt(air)) - 18 * air * air);
    return leg;
}

Arm swinging(double phase, const Figure& figure, double size) {
    const double swing = size * 38 * wave(phase + 0.25);
    Arm arm;
    arm.wrist = figure.neck + Point{0, 7} + turned({0, 33}, -swing);
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
    figure.pelvis = {BodyX, 84 - rise};
    figure.neck = {BodyX + 4, 50 - rise};
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
