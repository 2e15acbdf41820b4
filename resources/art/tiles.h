#pragma once

#include "resources/art/tile_kit.h"

namespace art {

// The backdrop with the given number, 1 to 10. Number 1 is in the sixteen fixed colours.
Tile drawTile(int number);

} // namespace art
