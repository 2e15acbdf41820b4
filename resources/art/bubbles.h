#pragma once

#include "resources/art/picture.h"

namespace art {

// The speech bubble with its tail at the left edge, 160 by 95. The other one is its mirror picture.
Picture drawBubble();

} // namespace art
