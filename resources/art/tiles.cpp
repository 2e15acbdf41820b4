#include "resources/art/tiles.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <stdexcept>

namespace art {

namespace {

constexpr double Turn = 2 * std::numbers::pi;

// Drifting mist: white and light grey, with a fixed grain of four by four pixels between them. The
// size isn't a multiple of four, so the grain of three by three is what fits.
Tile mist() {
    constexpr int Size = 135;
    constexpr double Grain[3][3] = {{0.1, 0.55, 0.3}, {0.75, 0.9, 0.45}, {0.35, 0.65, 0.2}};
    Tile tile{Picture(Size, Size), {SixteenColours.begin(), SixteenColours.end()}};
    for (int y = 0; y < Size; ++y) {
        for (int x = 0; x < Size; ++x) {
            const double light = 1.9 * clouds(x, y, Size, 3, 3, 11) - 0.5;
            tile.picture.set(x, y, light > Grain[y % 3][x % 3] ? White : LightGrey);
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
        const double round = 0.5 - 0.14 * std::fabs(along - 1.5);
        const double uneven = across ? hills(x, y, Size, 6, 24, 3) : hills(x, y, Size, 24, 6, 4);
        return round + 0.35 * uneven + (across ? 0.06 : 0);
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
    return shadedTile(Size, {222, 184, 134}, {248, 222, 180}, [](double x, double y) {
        const double bend = 9 * hills(x, y, Size, 2, 4, 31);
        const double grain = std::sin(Turn * ((y + bend) * 8 / Size));
        return 0.5 + 0.16 * grain + 0.4 * (hills(x, y, Size, 4, 48, 32) - 0.5);
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
        const double bend = 1.6 * clouds(x, y, Size, 3, 4, 41);
        const double vein = std::fabs(std::sin(Turn * ((x + y) / Size + bend)));
        return 0.45 + 0.35 * std::min(1.0, vein * 2.2) + 0.3 * (clouds(x, y, Size, 4, 3, 47) - 0.5);
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
        return 0.3 + 0.5 * std::exp(-(second - first) / 2.2);
    });
}

// A quilt of soft lozenges in lilac.
Tile quilt() {
    constexpr int Size = 80;
    const Field height = [](double x, double y) {
        const double a = std::fabs(std::sin(Turn * (x + y) / 2 * 4 / Size));
        const double b = std::fabs(std::sin(Turn * (x - y) / 2 * 4 / Size));
        return std::sqrt(a * b);
    };
    return shadedTile(Size, {196, 182, 220}, {238, 230, 248}, relief(height, 0.6));
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
    constexpr Draw Draws[] = {mist,   linen,  plaster, maple, scales,
                              marble, bricks, water,   quilt, paper};
    if (number < 1 || number > static_cast<int>(std::size(Draws))) {
        throw std::out_of_range("there are ten backdrops");
    }
    return Draws[number - 1]();
}

} // namespace art
