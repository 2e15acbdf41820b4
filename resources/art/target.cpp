#include "resources/art/target.h"

namespace art {

namespace {

using Bytes = std::vector<std::uint8_t>;

constexpr int Size = 32;
constexpr int HotX = 16;
constexpr int HotY = 15;

enum class Shade { SeeThrough, Black, White };

// Rings about the middle of the dot: by the square of the distance from it.
Shade shadeAt(int x, int y) {
    const int far = (x - HotX) * (x - HotX) + (y - HotY) * (y - HotY);
    const bool dot = far <= 2;
    const bool ring = far >= 72 && far < 110;
    const bool edge = far <= 8 || (far >= 56 && far < 132);
    if (dot || ring) {
        return Shade::Black;
    }
    return edge ? Shade::White : Shade::SeeThrough;
}

void append(Bytes& bytes, std::uint32_t number, int count) {
    for (int i = 0; i < count; ++i) {
        bytes.push_back(static_cast<std::uint8_t>(number >> static_cast<unsigned>(8 * i)));
    }
}

// One bit a pixel, rows from the bottom up: 1 where the pixel has the shade.
void appendBits(Bytes& bytes, Shade shade) {
    for (int y = Size - 1; y >= 0; --y) {
        for (int x = 0; x < Size; x += 8) {
            unsigned byte = 0;
            for (int bit = 0; bit < 8; ++bit) {
                byte = byte * 2 + (shadeAt(x + bit, y) == shade ? 1U : 0U);
            }
            append(bytes, byte, 1);
        }
    }
}

} // namespace

Bytes targetCursor() {
    constexpr std::uint32_t HeaderSize = 40;
    constexpr std::uint32_t BitsSize = Size * Size / 8;
    Bytes bytes;
    append(bytes, 0, 2);
    append(bytes, 2, 2); // a cursor
    append(bytes, 1, 2); // one picture
    append(bytes, Size, 1);
    append(bytes, Size, 1);
    append(bytes, 0, 2);
    append(bytes, HotX, 2);
    append(bytes, HotY, 2);
    append(bytes, HeaderSize + 8 + 2 * BitsSize, 4);
    append(bytes, 22, 4); // where it begins
    append(bytes, HeaderSize, 4);
    append(bytes, Size, 4);
    append(bytes, 2 * Size, 4); // white pixels and see-through ones, one field above the other
    append(bytes, 1, 2);
    append(bytes, 1, 2);
    bytes.insert(bytes.end(), 24, 0);
    append(bytes, 0x000000, 4);
    append(bytes, 0xFFFFFF, 4);
    appendBits(bytes, Shade::White);
    appendBits(bytes, Shade::SeeThrough);
    return bytes;
}

} // namespace art
