#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace art {

struct Rgb {
    std::uint8_t red = 0;
    std::uint8_t green = 0;
    std::uint8_t blue = 0;
};

// The numbers of the sixteen fixed colours, in the order of the palette. Black is see-through.
enum Colour : std::uint8_t {
    Black,
    DarkRed,
    DarkGreen,
    DarkYellow,
    DarkBlue,
    DarkMagenta,
    DarkCyan,
    DarkGrey,
    LightGrey,
    Red,
    Green,
    Yellow,
    Blue,
    Magenta,
    Cyan,
    White
};

extern const std::array<Rgb, 16> SixteenColours;

// A field of colour numbers, rows from the top.
struct Picture {
    Picture(int width, int height, std::uint8_t fill = Black);

    int width;
    int height;
    std::vector<std::uint8_t> pixels;

    bool contains(int x, int y) const;
    // 0 outside the picture.
    std::uint8_t at(int x, int y) const;
    // Nothing happens outside the picture.
    void set(int x, int y, std::uint8_t colour);
};

// A piece of the picture; what lies outside it is 0.
Picture cut(const Picture& from, int left, int top, int width, int height);

Picture mirrored(const Picture& from);

} // namespace art
