#include "resources/art/picture.h"

namespace art {

const std::array<Rgb, 16> SixteenColours = {{{0, 0, 0},
                                             {128, 0, 0},
                                             {0, 128, 0},
                                             {128, 128, 0},
                                             {0, 0, 128},
                                             {128, 0, 128},
                                             {0, 128, 128},
                                             {128, 128, 128},
                                             {192, 192, 192},
                                             {255, 0, 0},
                                             {0, 255, 0},
                                             {255, 255, 0},
                                             {0, 0, 255},
                                             {255, 0, 255},
                                             {0, 255, 255},
                                             {255, 255, 255}}};

Picture::Picture(int w, int h, std::uint8_t fill)
    : width(w), height(h), pixels(static_cast<std::size_t>(w) * static_cast<std::size_t>(h), fill) {
}

bool Picture::contains(int x, int y) const {
    return x >= 0 && y >= 0 && x < width && y < height;
}

std::uint8_t Picture::at(int x, int y) const {
    return contains(x, y) ? pixels[static_cast<std::size_t>(y * width + x)] : std::uint8_t{0};
}

void Picture::set(int x, int y, std::uint8_t colour) {
    if (contains(x, y)) {
        pixels[static_cast<std::size_t>(y * width + x)] = colour;
    }
}

Picture cut(const Picture& from, int left, int top, int width, int height) {
    Picture piece(width, height);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x) {
            piece.set(x, y, from.at(left + x, top + y));
        }
    }
    return piece;
}

Picture mirrored(const Picture& from) {
    Picture turned(from.width, from.height);
    for (int y = 0; y < from.height; ++y) {
        for (int x = 0; x < from.width; ++x) {
            turned.set(from.width - 1 - x, y, from.at(x, y));
        }
    }
    return turned;
}

} // namespace art
