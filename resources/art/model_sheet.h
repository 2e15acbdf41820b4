#pragma once

#include "resources/art/image.h"

namespace art {

// Who he is, on one sheet: seen from the front, a quarter turned, half turned and from the side,
// with lines for his proportions; his faces from three sides; the colours he is painted in.
Image drawModelSheet();

} // namespace art
