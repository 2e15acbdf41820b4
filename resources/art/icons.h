#pragma once

#include "resources/art/picture.h"

namespace art {

// The sizes of the program's icon, in pixels. Up to 32 it is drawn in the sixteen colours, with
// black for see-through; from 48 on it is the emblem with smooth edges.
constexpr int SmallIcons[] = {16, 22, 24, 32};
constexpr int LargeIcons[] = {48, 64, 128, 256};

// A small icon; the size is one of those above.
Picture drawSmallIcon(int size);

} // namespace art
