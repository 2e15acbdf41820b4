#pragma once

#include "resources/art/outline.h"
#include "resources/art/picture.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace art {

// One colour, or two that take turns like the fields of a chessboard and stay where they are.
struct Ink {
    constexpr Ink(Colour plain) : even(plain), odd(plain) {}

    constexpr Ink(Colour first, Colour second) : even(first), odd(second) {}

    Colour even;
    Colour odd;

    Colour at(int x, int y) const {
        return (x + y) % 2 == 0 ? even : odd;
    }
};

// Which pixels belong to something: 1 or 0 in the place of a colour.
using Mask = Picture;

// A thing to be painted: everything inside any of its outlines. The light comes from the upper
// left, so a rim at the right and below, as wide as `shadow` says in pixels, is in the shade.
struct Part {
    std::vector<Outline> outlines;
    Ink lit = White;
    Ink shade = LightGrey;
    int shadow = 2;
    // The rim at the left and above, one pixel wide, where the light falls on it.
    std::optional<Ink> glow = std::nullopt;
};

// The pixels of which at least half lies inside.
Mask coverage(const std::vector<Outline>& outlines, int width, int height);

// Paints the part with a line of one pixel round it. Gives the part's pixels without the line.
Mask paintOutlined(Picture& picture, const Part& part, Colour line);
// Paints the part without a line, on those pixels only that the mask has.
void paintWithin(Picture& picture, const Part& part, const Mask& within);

// Lines of letters, one for each pixel, painted from the given corner. A blank leaves a pixel as it
// is and s gives it the ink `skin`; the others are the sixteen colours in their order: .rgybmcd are
// black and the dark ones, lRGYBMCW light grey and the bright ones.
void stamp(Picture& picture, int left, int top, const std::vector<std::string>& rows, Ink skin);

// Fills see-through spots of at most `limit` pixels that the figure encloses.
void fillSpecks(Picture& picture, std::size_t limit, Colour colour);

} // namespace art
