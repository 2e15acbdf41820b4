#include "resources/art/image.h"

#include <cstddef>

namespace art {

namespace {

std::uint8_t middle(std::uint8_t a, std::uint8_t b) {
    return static_cast<std::uint8_t>((a + b + 1) / 2);
}

} // namespace

Image::Image(int w, int h)
    : width(w), height(h), pixels(static_cast<std::size_t>(w) * static_cast<std::size_t>(h)) {}

Rgba& Image::at(int x, int y) {
    return pixels[static_cast<std::size_t>(y * width + x)];
}

const Rgba& Image::at(int x, int y) const {
    return pixels[static_cast<std::size_t>(y * width + x)];
}

Rgba blended(Ink ink) {
    const Rgb a = SixteenColours[ink.even];
    const Rgb b = SixteenColours[ink.odd];
    return {middle(a.red, b.red), middle(a.green, b.green), middle(a.blue, b.blue), 255};
}

Image trueColours(const Picture& picture) {
    Image image(picture.width, picture.height);
    place(image, picture, 0, 0, 1);
    return image;
}

void place(Image& image, const Picture& picture, int left, int top, int scale) {
    for (int y = 0; y < picture.height * scale; ++y) {
        for (int x = 0; x < picture.width * scale; ++x) {
            const std::uint8_t colour = picture.at(x / scale, y / scale);
            const bool inside =
                left + x >= 0 && left + x < image.width && top + y >= 0 && top + y < image.height;
            if (colour != Black && inside) {
                image.at(left + x, top + y) = blended(static_cast<Colour>(colour));
            }
        }
    }
}

} // namespace art
