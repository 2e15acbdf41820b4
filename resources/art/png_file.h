#pragma once

#include "resources/art/image.h"

#include <cstdint>
#include <vector>

namespace art {

// The bytes of a PNG file with 8 bits for each of red, green, blue and alpha. It is packed here, in
// a plain way, so that the bytes don't depend on the packing library of a machine.
std::vector<std::uint8_t> pngBytes(const Image& image);

} // namespace art
