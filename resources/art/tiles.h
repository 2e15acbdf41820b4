#pragma once

#include "resources/art/tile_kit.h"

#include <vector>

namespace art {

// The backdrops, from number 1 on. Number 1 is in the sixteen fixed colours.
std::vector<Tile> drawTiles();

} // namespace art
