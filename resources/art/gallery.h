#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace art {

// A finished bitmap file.
struct Exhibit {
    // The name of the resource, without an ending.
    std::string name;
    std::vector<std::uint8_t> bytes;
};

// Draws every picture that the program shows on its stage: always the same bytes.
std::vector<Exhibit> drawGallery();

} // namespace art
