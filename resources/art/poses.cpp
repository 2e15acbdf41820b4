#include "resources/art/poses.h"

namespace art {

const std::array<Point, PoseCount> EyeCells = {
    {{53, 17}, {58, 14}, {56, 16}, {59, 14}, {55, 15}, {63, 16}, {57, 17}, {64, 15}}};
const std::array<Point, PoseCount> MouthCells = {
    {{57, 32}, {62, 34}, {56, 32}, {55, 34}, {55, 32}, {59, 31}, {60, 32}, {64, 31}}};

namespace {

// He stands at ease.
Figure standing() {
    Figure figure;
    figure.neck = {62, 50};
    figure.pelvis = {63, 86};
    figure.arms = {Arm{{36, 84}, 105, Grip::Relaxed, 1, -1, false},
                   Arm{{90, 84}, 75, Grip::Relaxed, -1, 1, false}};
    figure.legs = {Leg{{54, Ground - 6}, 0, -0.8, 1}, Leg{{72, Ground - 6}, 0, 0.8, -1}};
    return figure;
}

} // namespace

Figure pose(int number) {
    Figure figure = standing();
    const auto index = static_cast<std::size_t>(number);
    figure.head.eyeCell = EyeCells[index];
    figure.head.mouthCell = MouthCells[index];
    figure.head.turn = (MouthCells[index].x - EyeCells[index].x) / 4;
    figure.neck.x = chin(figure.head).x;
    return figure;
}

Figure turningRight(int number) {
    Figure figure = standing();
    figure.turn = number == 1 ? 0.5 : 0.2;
    figure.head.eyeCell = {57, 17};
    figure.head.mouthCell = {60, 33};
    figure.head.turn = number == 1 ? 1 : 0.5;
    return figure;
}

} // namespace art
