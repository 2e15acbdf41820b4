#pragma once

#include "resources/art/figure.h"

namespace art {

constexpr int WalkCount = 8;

// A picture of the walk to the right, numbered from 1. Pictures 2 to 8 are a loop; picture 1 is a
// small first step.
Figure walkingRight(int number);

} // namespace art
