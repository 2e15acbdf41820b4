#pragma once

#include "resources/art/picture.h"

#include <cstdint>
#include <span>
#include <string>
#include <vector>

namespace art {

// How a picture is stored.
struct BmpForm {
    // 4 or 8 bits a pixel. The colour table always has 16 or 256 entries.
    int bitsPerPixel = 4;
    // What the header says of the number of colours; 0 stands for all that the depth allows.
    std::uint32_t coloursUsed = 0;
};

// The bytes of an uncompressed bitmap file, rows from the bottom up. Colours that the table doesn't
// name are black.
std::vector<std::uint8_t> bmpBytes(const Picture& picture, std::span<const Rgb> colours,
                                   BmpForm form);

// False if the file can't be written whole.
bool writeFile(const std::string& path, std::span<const std::uint8_t> bytes);

} // namespace art
