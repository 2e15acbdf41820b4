#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace art {

// A finished file.
struct Exhibit {
    // Where it lies in the directory resources/.
    std::string file;
    std::vector<std::uint8_t> bytes;
};

// Draws every picture that the program has: always the same bytes.
std::vector<Exhibit> drawGallery();

} // namespace art
