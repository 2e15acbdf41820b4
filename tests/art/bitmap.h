// The program's picture files, read for the tests.
#pragma once

#include <cstddef>
#include <cstdint>
#include <string>
#include <vector>

using Bytes = std::vector<std::uint8_t>;

constexpr std::uint32_t Black = 0;
constexpr std::uint32_t White = 0xFFFFFF;

struct Bitmap {
    std::string name;
    int width = 0;
    int height = 0;
    std::uint32_t bits = 0;
    std::vector<std::uint32_t> colours;
    std::vector<std::uint32_t> pixels; // as colours

    std::uint32_t at(int x, int y) const {
        return pixels.at(static_cast<std::size_t>(y * width + x));
    }
};

/// A file of resources/.
Bytes readFile(const std::string& name);
/// A file of resources/bitmaps/, named without its extension.
Bytes readBitmap(const std::string& name);
/// The 24 bits at a place, the lowest first.
std::uint32_t number(const Bytes& bytes, std::size_t at);

/// A bitmap of 4 or 8 bits a pixel, named without its extension.
Bitmap load(const std::string& name);
/// The bitmaps with the numbers from 1 behind the stem.
std::vector<Bitmap> series(const std::string& stem, int count);
/// All pictures of him.
std::vector<Bitmap> figures();

/// The size of the smallest black area that doesn't reach the picture's edge.
std::size_t smallestHole(const Bitmap& bitmap);
