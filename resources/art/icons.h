#pragma once

#include "resources/art/image.h"
#include "resources/art/picture.h"

#include <string>

namespace art {

// The sizes of each icon, in pixels. Up to 32 it is drawn in the sixteen colours, with
// black for see-through; from 48 on it has smooth edges.
constexpr int SmallIcons[] = {16, 22, 24, 32};
constexpr int LargeIcons[] = {48, 64, 128, 256};

// The program's icon, which is the emblem; the size is one of those above.
Picture drawSmallIcon(int size);
Image drawLargeIcon(int size);
std::string iconSvg();

// The icon of a Toon's file: the emblem on a sheet of paper.
Picture drawSmallToonIcon(int size);
Image drawLargeToonIcon(int size);
std::string toonIconSvg();

} // namespace art
