#pragma once

#include <cstdint>
#include <vector>

namespace art {

// The pointer with which a place is chosen: a ring with a dot, 32 by 32, black with a white edge.
// These are the bytes of a cursor file of two colours; its hot spot is the dot, at (16, 15).
std::vector<std::uint8_t> targetCursor();

} // namespace art
