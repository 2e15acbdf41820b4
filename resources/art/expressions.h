#pragma once

#include "resources/art/picture.h"

namespace art {

// The sheet of faces: a column for each of the five expressions, a row for each pose, cells of ten
// by ten pixels with a white line between them.
Picture drawExpressions();

} // namespace art
