#pragma once

#include "resources/art/figure.h"

#include <array>

namespace art {

constexpr int PoseCount = 8;

// Where the cells of eyes and mouth lie in the picture of each pose.
extern const std::array<Point, PoseCount> EyeCells;
extern const std::array<Point, PoseCount> MouthCells;

// The figure in a pose, numbered from 0.
Figure pose(int number);

// The two pictures in which he turns from us to the right, 1 half turned and 2 nearly seen from the
// front.
Figure turningRight(int number);

} // namespace art
