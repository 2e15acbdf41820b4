#include "resources/art/poses.h"

namespace art {

const std::array<Point, PoseCount> EyeCells = {
    {{53, 17}, {58, 14}, {56, 16}, {59, 14}, {55, 15}, {63, 16}, {57, 17}, {64, 15}}};
const std::array<Point, PoseCount> MouthCells = {
    {{57, 32}, {62, 34}, {56, 32}, {55, 34}, {55, 32}, {59, 31}, {60, 32}, {64, 31}}};

namespace {

Leg planted(double x, double toe) {
    return {{x, Ground - 6}, 0, toe, toe < 0 ? 1 : -1};
}

// What all poses start from: he stands at ease, his head where the pose has it.
Figure standing(Head head) {
    Figure figure;
    figure.head = head;
    figure.neck = chin(head) + Point{0, 2};
    figure.pelvis = {(figure.neck.x + 2 * 63) / 3, 84};
    figure.arms = {Arm{figure.neck + Point{-21, 38}, 98, Grip::Relaxed, 1, -1, false, 0.01},
                   Arm{figure.neck + Point{21, 38}, 82, Grip::Relaxed, -1, 1, false, 0.01}};
    figure.legs = {planted(figure.pelvis.x - 9, -0.8), planted(figure.pelvis.x + 9, 0.8)};
    return figure;
}

// One leg carries him, the other is at ease.
void stand(Figure& figure) {
    figure.pelvis = {58, 84};
    figure.arms[1] = {figure.neck + Point{18, 36}, 120, Grip::Relaxed, -1, 1};
    figure.arms[1].elbow = figure.neck + Point{26, 21};
    figure.legs = {planted(53, -0.7), planted(75, 1)};
}

void startle(Figure& figure) {
    figure.head.brows = Brows::High;
    figure.head.eyes = Eyes::Wide;
    figure.head.mouth = Mouth::Gasp;
    figure.head.capSwing = 27;
    figure.shoulderLift = 4;
    figure.pelvis.x = 66;
    // Higher than the bubble's tail and nearer than its body, which hides one of them otherwise.
    figure.arms[0] = {{37, 36}, -97, Grip::Open, -1, 1};
    figure.arms[0].elbow = {{32, 54}};
    figure.arms[1] = {{93, 33}, -78, Grip::Open, 1, -1};
    figure.arms[1].elbow = {{98, 52}};
    figure.legs = {Leg{{46, Ground - 6}, 0, -0.9, -1, 0.04},
                   Leg{{88, Ground - 6}, 0, 0.9, 1, 0.03}};
}

void swear(Figure& figure) {
    figure.arms[0] = {{34, 80}, 125, Grip::Relaxed, 1, -1, false, 0.02};
    figure.arms[1] = {{77, 69}, 205, Grip::Flat, -1, 1};
    figure.arms[1].elbow = {{88, 73}};
    figure.legs = {planted(54, -0.8), planted(72, 0.8)};
}

void point(Figure& figure) {
    figure.head.brows = Brows::OneUp;
    figure.pelvis.x = 68;
    figure.arms[0] = {{26, 58}, 182, Grip::Pointing, -1, -1, false, 0.03};
    figure.arms[1] = {{82, 80}, 150, Grip::Fist, -1, -1, false, 1};
    figure.legs = {planted(49, -1), planted(76, 0.8)};
}

void embrace(Figure& figure) {
    figure.head.brows = Brows::Raised;
    figure.head.mouth = Mouth::Grin;
    // Low enough that the bubble leaves both hands free.
    figure.arms[0] = {{25, 86}, 176, Grip::Open, -1, 1};
    figure.arms[0].elbow = {{37, 75}};
    figure.arms[1] = {{100, 86}, 4, Grip::Open, 1, -1};
    figure.arms[1].elbow = {{88, 75}};
    figure.legs = {planted(48, -0.8), planted(77, 0.8)};
}

void think(Figure& figure) {
    figure.head.brows = Brows::OneUp;
    figure.head.mouth = Mouth::Musing;
    figure.pelvis.x = 64;
    figure.arms[0] = {{55, 58}, -66, Grip::Pointing, 1, -1};
    figure.arms[0].elbow = {{37, 75}};
    figure.arms[1] = {{56, 82}, 190, Grip::Flat, -1, 1, false, 0.6};
    figure.arms[1].elbow = {{82, 78}};
    figure.legs = {planted(52, -0.9), planted(74, 0.7)};
}

void laugh(Figure& figure) {
    figure.head.brows = Brows::Raised;
    figure.head.eyes = Eyes::Merry;
    figure.head.mouth = Mouth::Laugh;
    figure.head.capSwing = 18;
    figure.shoulderLift = 2;
    figure.neck.x -= 3;
    figure.pelvis = {70, 85};
    figure.arms[0] = {{56, 80}, 0, Grip::Flat, 1, -1};
    figure.arms[0].elbow = {{37, 72}};
    figure.arms[1] = {{86, 75}, 165, Grip::Flat, -1, 1};
    figure.arms[1].elbow = {{94, 66}};
    figure.legs = {Leg{{54, Ground - 6}, 0, -0.9, 1, 0.1}, Leg{{88, Ground - 6}, 0, 1, -1, 0.06}};
}

// He leans over to whoever listens on the left and screens his mouth from the others.
void whisper(Figure& figure) {
    figure.head.turn = -0.5;
    figure.head.brows = Brows::OneUp;
    figure.head.eyes = Eyes::Aside;
    figure.head.mouth = Mouth::Whisper;
    figure.pelvis = {82, 85};
    figure.arms[0] = {{70, 82}, 20, Grip::Relaxed, 1, 1, true, 0.3};
    figure.arms[1] = {{82, 50}, -106, Grip::Screen, -1, -1};
    figure.arms[1].elbow = {{101, 64}};
    figure.legs = {Leg{{68, Ground - 6}, 0, -1, 1, 0.1}, planted(96, 0.9)};
}

// A foot that stands on its toes only: it is about to leave the ground.
Leg leaving(const Figure& figure, std::size_t which, Leg leg, double heelUp) {
    const double side = leg.toe < 0 ? -1 : 1;
    // The round tip of the shoe would dip below the ground.
    const Point ball = {leg.ankle.x + 10 * leg.toe, Ground - 1};
    const double length = distance(hip(figure, which), leg.ankle) * (1 + leg.slack);
    leg.ankle = ball + turned({-10 * leg.toe, -6}, heelUp * side);
    leg.angle = heelUp;
    leg.slack = length / distance(hip(figure, which), leg.ankle) - 1;
    return leg;
}

// An arm that hangs at ease, the hand as far from the shoulder as told.
Arm hanging(const Figure& figure, std::size_t which, Point reach, double angle, int thumb) {
    Arm arm;
    arm.wrist = shoulder(figure, which) + reach;
    arm.angle = angle;
    arm.bend = which == 0 ? 1 : -1;
    arm.thumb = thumb;
    arm.slack = 0.02;
    return arm;
}

} // namespace

Figure pose(int number) {
    using Strike = void (*)(Figure&);
    constexpr Strike Strikes[PoseCount] = {stand,   startle, swear, point,
                                           embrace, think,   laugh, whisper};
    const auto index = static_cast<std::size_t>(number);
    Head head;
    head.eyeCell = EyeCells[index];
    head.mouthCell = MouthCells[index];
    head.turn = (head.mouthCell.x - head.eyeCell.x) / 4;
    Figure figure = standing(head);
    Strikes[index](figure);
    return figure;
}

Figure turningRight(int number) {
    const bool half = number == 1;
    Head head;
    head.eyeCell = {half ? 59.0 : 57.0, 17};
    head.mouthCell = {half ? 63.0 : 58.0, 33};
    head.turn = half ? 1 : 0.25;
    head.capSwing = half ? 10 : 4;
    Figure figure = standing(head);
    figure.turn = half ? 0.45 : 0.2;
    figure.neck.x -= half ? 3 : 1;
    figure.pelvis.x = half ? 62 : 62.5;
    figure.arms[0] = hanging(figure, 0, half ? Point{-4, 30} : Point{-5, 29.5}, 94, -1);
    figure.arms[1] =
        hanging(figure, 1, half ? Point{8, 29} : Point{5, 29.5}, half ? 70 : 86, half ? -1 : 1);
    figure.arms[1].behind = half;
    // He gets on by a step between the two: the right foot leaves the ground in one, the left in
    // the other.
    if (half) {
        figure.legs = {planted(figure.pelvis.x - 11, 0.8), planted(figure.pelvis.x + 7, 0.9)};
        figure.legs[0] = leaving(figure, 0, figure.legs[0], 22);
    } else {
        figure.legs = {planted(figure.pelvis.x - 8, -0.55), planted(figure.pelvis.x + 8, 0.85)};
        figure.legs[1] = leaving(figure, 1, figure.legs[1], 20);
    }
    return figure;
}

} // namespace art
