#include "resources/art/tiles.h"

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <iterator>
#include <numbers>
#include <stdexcept>

namespace art {

namespace {

constexpr double Turn = 2 * std::numbers::pi;

// Herringbone cloth, light grey on white.
Tile herringbone() {
    constexpr int Size = 135;
    constexpr int Rib = 15;
    constexpr int Thread = 5;
    Tile tile{Picture(Size, Size), {SixteenColours.begin(), SixteenColours.end()}};
    for (int y = 0; y < Size; ++y) {
        for (int x = 0; x < Size; ++x) {
            const int slope = std::abs(x % Rib - Rib / 2);
            tile.picture.set(x, y, (y + slope) % Thread < 2 ? LightGrey : White);
        }
    }
    return tile;
}

// Coarse linen: threads over and under, each a little uneven.
Tile linen() {
    constexpr int Size = 96;
    return shadedTile(Size, {214, 196, 160}, {246, 236, 212}, [](double x, double y) {
        const bool across = (static_cast<int>(x / 4) + static_cast<int>(y / 4)) % 2 == 0;
        const double along = std::fmod(across ? y : x, 4.0);
        const double round = 0.55 - 0.14 * std::fabs(along - 1.5);
        const double uneven = across ? hills(x, y, Size, 6, 24, 3) : hills(x, y, Size, 24, 6, 4);
        return round + 0.26 * uneven + (across ? 0.06 : 0);
    });
}

// Rough plaster in the blue of a summer house.
Tile plaster() {
    constexpr int Size = 80;
    const Field height = [](double x, double y) { return clouds(x, y, Size, 10, 3, 21); };
    return shadedTile(Size, {168, 196, 222}, {222, 236, 248}, relief(height, 1.0));
}

// A board of light wood, its grain running across.
Tile maple() {
    constexpr int Size = 96;
    return shadedTile(Size, {226, 194, 150}, {250, 228, 192}, [](double x, double y) {
        const double bend = 9 * hills(x, y, Size, 2, 4, 31);
        const double grain = std::sin(Turn * ((y + bend) * 8 / Size));
        return 0.55 + 0.1 * grain + 0.3 * (hills(x, y, Size, 4, 48, 32) - 0.5);
    });
}

// Scales in pale green, each row half a scale aside.
Tile scales() {
    constexpr int Size = 80;
    return shadedTile(Size, {176, 206, 168}, {226, 240, 216}, [](double x, double y) {
        double shade = 0;
        for (int row = -1; row <= 1; ++row) {
            const double line = std::floor(y / 10) + row;
            const double shift = std::fmod(line + 2, 2.0) * 10;
            const double cx = std::floor((x - shift) / 20) * 20 + shift + 9.5;
            const double gap = std::hypot(x - cx, y - line * 10);
            if (gap < 11.5) {
                shade = 1 - gap / 11.5;
            }
        }
        return 0.28 + 0.55 * std::sqrt(shade);
    });
}

// Rosy marble with fine veins.
Tile marble() {
    constexpr int Size = 96;
    return shadedTile(Size, {214, 176, 176}, {248, 230, 226}, [](double x, double y) {
        const double bend = 1.2 * clouds(x, y, Size, 4, 4, 41);
        const double vein = std::fabs(std::sin(Turn * ((x + y) / Size + bend)));
        return 0.6 + 0.18 * std::min(1.0, vein * 1.4) + 0.3 * (clouds(x, y, Size, 4, 3, 47) - 0.5);
    });
}

// A whitewashed brick wall.
Tile bricks() {
    constexpr int Size = 80;
    return shadedTile(Size, {206, 186, 166}, {250, 242, 228}, [](double x, double y) {
        const int row = static_cast<int>(y) / 10;
        const int along = (static_cast<int>(x) + (row % 2) * 10) % 20;
        const int down = static_cast<int>(y) % 10;
        const int brick = ((static_cast<int>(x) + (row % 2) * 10) % Size) / 20;
        const double rough = 0.25 * (clouds(x, y, Size, 20, 2, 51) - 0.5);
        const double own = 0.16 * (chance(brick, row, 52) - 0.5);
        if (down == 9 || along == 19) {
            return 0.42 + rough;
        }
        return 0.68 + own + rough + (down == 0 || along == 0 ? 0.12 : 0) -
               (down == 8 || along == 18 ? 0.1 : 0);
    });
}

// Sunlight on the floor of a pool.
Tile water() {
    constexpr int Size = 96;
    const auto points = scattered(Size, 5, 61);
    return shadedTile(Size, {150, 210, 212}, {226, 248, 244}, [points](double x, double y) {
        const double sway = 3 * std::sin(Turn * 2 * y / Size);
        const double dip = 3 * std::sin(Turn * 2 * x / Size);
        double second = 0;
        const double first = nearest(points, std::fmod(x + sway + Size, Size),
                                     std::fmod(y + dip + Size, Size), Size, second);
        return 0.38 + 0.34 * std::exp(-(second - first) / 3.5);
    });
}

// A quilt of soft lozenges in lilac.
Tile quilt() {
    constexpr int Size = 80;
    return shadedTile(Size, {196, 182, 220}, {238, 230, 248}, [](double x, double y) {
        // Two ways across the lozenge, each 0 at a seam and 1 in the middle.
        const double down = std::fabs(std::sin(Turn * (x + y) * 2 / Size));
        const double up = std::fabs(std::sin(Turn * (x - y) * 2 / Size));
        const double tilt = std::sin(Turn * (x + y) * 4 / Size);
        return 0.3 + 0.4 * std::sqrt(down * up) + 0.12 * tilt * up;
    });
}

// Creased packing paper.
Tile paper() {
    constexpr int Size = 80;
    const auto points = scattered(Size, 4, 71);
    const Field height = [points](double x, double y) {
        double second = 0;
        const double first =
            nearest(points, std::fmod(x + Size, Size), std::fmod(y + Size, Size), Size, second);
        return (second - first) / 12 + 0.4 * clouds(x, y, Size, 20, 2, 72);
    };
    return shadedTile(Size, {204, 190, 150}, {244, 236, 206}, relief(height, 0.5));
}

} // namespace

Tile drawTile(int number) {
    using Draw = Tile (*)();
    constexpr Draw Draws[] = {herringbone, linen,  plaster, maple, scales,
                              marble,      bricks, water,   quilt, paper};
    if (number < 1 || number > static_cast<int>(std::size(Draws))) {
        throw std::out_of_range("there are ten backdrops");
    }
    return Draws[number - 1]();
}

} // namespace art
