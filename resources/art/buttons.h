#pragma once

#include "resources/art/picture.h"

namespace art {

// The pictures on the small buttons of a window, 44 by 11: a bar low in the first eleven columns, a
// cross in the next eleven, and from column 20 on a small figure that walks, in the middle of a
// button of 28 columns of which the bitmap holds 24.
Picture drawSysButtons();

} // namespace art
