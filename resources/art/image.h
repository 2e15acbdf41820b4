#pragma once

#include "resources/art/painter.h"
#include "resources/art/picture.h"

#include <cstdint>
#include <vector>

namespace art {

struct Rgba {
    std::uint8_t red = 0;
    std::uint8_t green = 0;
    std::uint8_t blue = 0;
    std::uint8_t alpha = 0;
};

// A field of true colours, rows from the top; see-through at first.
struct Image {
    Image(int width, int height);

    int width;
    int height;
    std::vector<Rgba> pixels;

    Rgba& at(int x, int y);
    const Rgba& at(int x, int y) const;
};

// One colour for both colours of the ink.
Rgba blended(Ink ink);

// The picture in true colours; black stays see-through.
Image trueColours(const Picture& picture);

// Puts a picture on the image, each of its pixels a square of `scale` pixels. Black is see-through;
// what lies outside the image is left out.
void place(Image& image, const Picture& picture, int left, int top, int scale);

} // namespace art
