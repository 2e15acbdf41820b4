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
    figure.neck = {chin(head).x, 50};
    figure.pelvis = {(figure.neck.x + 2 * 63) / 3, 84};
    figure.arms = {Arm{figure.neck + Point{-23, 35}, 100, Grip::Relaxed, 1, -1, false},
                   Arm{figure.neck + Point{23, 35}, 80, Grip::Relaxed, -1, 1, false}};
    figure.legs = {planted(figure.pelvis.x - 9, -0.8), planted(figure.pelvis.x + 9, 0.8)};
    return figure;
}

void welcome(Figure& figure) {
    figure.pelvis.x -= 2;
    figure.arms[1] = {{95, 74}, 12, Grip::Open, 1, 1, false, 0.08};
}

void cheer(Figure& figure) {
    figure.head.brows = Brows::Raised;
    figure.arms[0] = {{22, 38}, -105, Grip::Open, -1, 1, false, 0.12};
    figure.arms[1] = {{108, 36}, -75, Grip::Open, 1, -1, false, 0.12};
    figure.legs = {planted(47, -0.8), planted(81, 0.8)};
}

void crossArms(Figure& figure) {
    figure.arms[0] = {{73, 70}, -12, Grip::Fist, 1, -1, false, 1};
    figure.arms[1] = {{50, 74}, 192, Grip::Fist, -1, 1, false, 1};
    figure.legs = {planted(55, -0.8), planted(69, 0.8)};
}

void point(Figure& figure) {
    figure.head.brows = Brows::OneUp;
    figure.pelvis.x = 68;
    figure.arms[0] = {{26, 58}, 182, Grip::Pointing, -1, -1, false, 0.03};
    figure.arms[1] = {{82, 80}, 150, Grip::Fist, -1, -1, false, 1};
    figure.legs = {planted(49, -1), planted(76, 0.8)};
}

void shrug(Figure& figure) {
    figure.head.brows = Brows::Worried;
    figure.shoulderLift = 4;
    figure.arms[0] = {{27, 62}, 200, Grip::Open, -1, 1, false, 0.3};
    figure.arms[1] = {{97, 62}, -20, Grip::Open, 1, -1, false, 0.3};
}

void think(Figure& figure) {
    figure.head.brows = Brows::Raised;
    figure.pelvis.x = 62;
    figure.arms[1] = {{52, 80}, 185, Grip::Fist, -1, 1, false, 1};
    figure.arms[0] = {{60, 58}, -104, Grip::Pointing, 1, 1, false, 10};
    figure.legs = {planted(52, -0.9), planted(72, 0.7)};
}

void wave(Figure& figure) {
    figure.head.brows = Brows::Raised;
    figure.pelvis.x = 59;
    figure.arms[1] = {{103, 40}, -75, Grip::Open, 1, -1, false, 0.15};
    figure.legs = {planted(51, -0.7), planted(72, 0.9)};
}

void bow(Figure& figure) {
    figure.pelvis.x = 61;
    figure.arms[0] = {{68, 72}, -8, Grip::Relaxed, 1, -1, false, 1};
    figure.arms[1] = {{106, 70}, 8, Grip::Open, 1, 1, false, 0.08};
    figure.legs = {Leg{{34, Ground - 8}, -25, -1, 1, 0.01},
                   Leg{{72, Ground - 6}, 0, 0.9, -1, 0.08}};
}

} // namespace

Figure pose(int number) {
    using Strike = void (*)(Figure&);
    constexpr Strike Strikes[PoseCount] = {welcome, cheer, crossArms, point,
                                           shrug,   think, wave,      bow};
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
    head.mouthCell = {half ? 63.0 : 59.0, 33};
    head.turn = half ? 1 : 0.5;
    head.capSwing = half ? 10 : 4;
    Figure figure = standing(head);
    figure.turn = half ? 0.45 : 0.2;
    return figure;
}

} // namespace art
