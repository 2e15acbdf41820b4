#pragma once

#include "resources/art/picture.h"

namespace art {

// The edge that faces him.
enum class Tail { Left, Right };

// The speech bubble, 160 by 95, with the tip of its tail 50 rows down. It is white but for a touch
// of shade beside the field of its text, on its lower right.
Picture drawBubble(Tail tail);

} // namespace art
