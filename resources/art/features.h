#pragma once

#include "resources/art/head.h"
#include "resources/art/picture.h"

namespace art {

// Brows, eyes and mouth, drawn pixel by pixel into the two cells of the head.
void paintFeatures(Picture& picture, const Head& head);

} // namespace art
