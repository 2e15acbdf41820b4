// The program's pictures as the files have them.
#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace ground {

struct Picture {
    std::string name;
    int width = 0;
    int height = 0;
    std::vector<std::uint32_t> pixels; // 0x00rrggbb, from the top down

    std::uint32_t at(int x, int y) const {
        return pixels[static_cast<std::size_t>(y * width + x)];
    }
};

/// One of resources/bitmaps, of 4 or 8 bits a pixel.
Picture loadPicture(const std::string& name);

/// The 28 pictures of the character.
std::vector<Picture> characterPictures();

} // namespace ground
