#include "resources/art/tiles.h"

#include "resources/art/outline.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <cstddef>
#include <numbers>

namespace art {

namespace {

constexpr double Turn = 2 * std::numbers::pi;

// ---- 1: Somebody has walked here, not quite straight: trails of footprints on paper.

// Is the place, seen from the middle of a print that points to the right, on the sole or the heel?
bool onPrint(Point place) {
    const double sole = std::hypot((place.x - 1.9) / 4.3, place.y / (2.4 + 0.14 * place.x));
    const double heel = std::hypot((place.x + 5) / 2, place.y / 2.1);
    return std::min(sole, heel) < 1;
}

void addPrint(Picture& picture, Point centre, double heading) {
    const int size = picture.width;
    for (int y = 0; y < size; ++y) {
        for (int x = 0; x < size; ++x) {
            const Point gap = {shortestWay(centre.x, x + 0.5, size),
                               shortestWay(centre.y, y + 0.5, size)};
            if (onPrint(turned(gap, -heading))) {
                // Every second pixel, so that the grey is as soft as the other tiles.
                picture.set(x, y, (x + y) % 2 == 0 ? LightGrey : White);
            }
        }
    }
}

Tile footprints() {
    constexpr int Size = 135;
    constexpr int Steps = 8;
    Tile tile{Picture(Size, Size, White), {SixteenColours.begin(), SixteenColours.end()}};
    // Up to the right and out at the top, where the next tile's trail goes on.
    for (int i = 0; i < Steps; ++i) {
        const double share = (i + 0.5) / Steps;
        const double heading = -45 + 20 * std::cos(Turn * share);
        const double side = i % 2 == 0 ? 5 : -5;
        const Point sway = turned({0, 11 * std::sin(Turn * share)}, -45);
        const Point way = Point{share, 1.35 - share} * Size + sway;
        addPrint(tile.picture, way + turned({0, side}, heading), heading + 1.4 * side);
    }
    return tile;
}

// ---- 2: The floor of a coffee house: chips of stone in cream.

// How far out of a chip of five or six straight sides the place is; below 1 it lies inside.
double chipEdge(Point place, double radius, int sides, double turn) {
    const double sector = Turn / sides;
    const double angle = std::atan2(place.y, place.x) + turn + 2 * Turn;
    const double bent = std::fmod(angle, sector) - sector / 2;
    return std::hypot(place.x, place.y * 1.3) * std::cos(bent) / radius;
}

Tile terrazzo() {
    constexpr int Size = 96;
    constexpr int Chips = 60;
    constexpr Shade Ground = {241, 236, 224};
    const std::array<Shade, 5> stones = {
        {{233, 212, 198}, {214, 221, 220}, {236, 221, 193}, {217, 222, 204}, {249, 246, 239}}};
    const auto middles = strewn(Size, Chips, 3);
    return paintedTile(Size, [=](double x, double y) {
        Shade shade = lit(Ground, 6 * (clouds(x, y, Size, 16, 2, 5) - 0.5));
        for (int i = 0; i < Chips; ++i) {
            const auto& middle = middles[static_cast<std::size_t>(i)];
            const Point gap = {shortestWay(middle[0], x, Size), shortestWay(middle[1], y, Size)};
            const double radius = 1.5 + 1.9 * chance(i, 1, 7);
            const Point own = turned(gap, 360 * chance(i, 3, 7));
            if (chipEdge(own, radius, 4 + i % 3, i) < 1) {
                const Shade& stone = stones[static_cast<std::size_t>(i) % stones.size()];
                shade = lit(stone, 16 * (clouds(x, y, Size, 16, 2, 9) - 0.5));
            }
        }
        return shade;
    });
}

// ---- 3: A window on a day of rain: drops on blue glass.

Tile raindrops() {
    constexpr int Size = 80;
    constexpr int Drops = 30;
    const auto middles = strewn(Size, Drops, 21);
    return paintedTile(Size, [=](double x, double y) {
        const double mist = clouds(x, y, Size, 10, 3, 22) - 0.5;
        Shade shade = lit({198, 218, 238}, 6 * mist);
        for (int i = 0; i < Drops; ++i) {
            const auto& middle = middles[static_cast<std::size_t>(i)];
            const double radius = 1.2 + 1.9 * chance(i, 1, 23);
            const Point own =
                Point{shortestWay(middle[0], x, Size), shortestWay(middle[1], y, Size)} *
                (1 / radius);
            // A little heavier below than above.
            const double out = std::hypot(own.x, own.y * (own.y > 0 ? 0.8 : 0.95));
            if (out < 1) {
                // The light comes in at the upper left and gathers at the lower right.
                const double gathered = (own.x + own.y) * 0.7;
                const bool glint = distance(own, {-0.4, -0.4}) < 0.36;
                shade = lit({190, 213, 236}, glint ? 46 : 30 * gathered - 3);
            }
        }
        return shade;
    });
}

// ---- 4: Floorboards of light wood, each plank with its own tone and two nails at each end.

Tile boards() {
    constexpr int Size = 96;
    constexpr int Board = 24;
    constexpr std::array<int, 4> Ends = {13, 61, 37, 85};
    return paintedTile(Size, [=](double x, double y) {
        const int row = static_cast<int>(y) / Board;
        const double down = y - row * Board;
        const double along = shortestWay(Ends[static_cast<std::size_t>(row)], x, Size);
        const auto seed = static_cast<std::uint32_t>(31 + row);
        const double bend = 7 * hills(x, y, Size, 2, 4, seed);
        const double rings = std::sin(Turn * ((y + bend) * 16 / Size));
        const double fibre = hills(x, y, Size, 6, 48, seed + 8) - 0.5;
        const Shade wood = mix({241, 211, 168}, {238, 205, 160}, chance(row, 0, 36));
        const double nail = std::hypot(std::fabs(along) - 4, std::fabs(down - 11.5) - 6);
        const bool gap = down >= 23 || std::fabs(along) < 0.5;
        const double edge = down < 1 ? 7 : 0;
        return lit(wood, 3 * rings + 11 * fibre + edge - (gap ? 30 : 0) - (nail < 1 ? 26 : 0));
    });
}

// ---- 5: A roof of mossy shingles, each a little different.

Tile shingles() {
    constexpr int Size = 80;
    constexpr int Rows = 8;
    constexpr int Columns = 4;
    return paintedTile(Size, [=](double x, double y) {
        // The shingle of the highest row that reaches here lies on top.
        for (int row = static_cast<int>(y / 10) - 2;; ++row) {
            const double shift = row % 2 == 0 ? 0 : 10;
            const int column = static_cast<int>(std::floor((x - shift) / 20));
            const double across = x - shift - column * 20 - 10;
            const double down = y - row * 10;
            const double rim = 20 - 0.055 * across * across - 0.0002 * std::pow(across, 4);
            if (down < rim) {
                const double own =
                    chance((column + Columns) % Columns, (row + Rows) % Rows, 51) - 0.5;
                const double moss = clouds(x, y, Size, 8, 2, 52) - 0.5;
                const Shade green = mix({203, 224, 195}, {195, 218, 190}, 0.5 + 0.7 * own);
                const double lip = rim - down < 1.2 ? 7 : 0;
                return lit(green, (down - 14) * 0.9 + 9 * moss + lip - across * 0.25);
            }
        }
    });
}

// ---- 6: Petals that the wind has strewn.

Tile petals() {
    constexpr int Size = 96;
    constexpr int Petals = 26;
    const std::array<Shade, 3> tints = {{{249, 227, 228}, {240, 203, 209}, {246, 209, 207}}};
    const auto middles = strewn(Size, Petals, 41);
    return paintedTile(Size, [=](double x, double y) {
        Shade shade = lit({245, 217, 220}, 6 * (clouds(x, y, Size, 12, 2, 43) - 0.5));
        for (int i = 0; i < Petals; ++i) {
            const auto& middle = middles[static_cast<std::size_t>(i)];
            const Point gap = {shortestWay(middle[0], x, Size), shortestWay(middle[1], y, Size)};
            const double length = 9 + 4 * chance(i, 0, 44);
            const Point own = turned(gap, 360 * chance(i, 1, 44)) * (1 / length);
            const double along = own.x + 0.5;
            // Pointed at the stalk, broad and notched at the other end.
            const double tip = 1 - 0.5 * std::max(0.0, 0.12 - std::fabs(own.y));
            const double half = 0.42 * std::sqrt(std::max(0.0, along * (tip - along) * 4 * along));
            if (along > 0 && std::fabs(own.y) < half) {
                const Shade& tint = tints[static_cast<std::size_t>(i) % tints.size()];
                shade = lit(tint, 12 * (along - 0.5) - (own.y > 0 ? 5 : 0));
            }
        }
        return shade;
    });
}

// ---- 7: A wall of pale red bricks with broad joints.

Tile bricks() {
    constexpr int Size = 80;
    const std::array<Shade, 4> clays = {
        {{232, 192, 172}, {229, 187, 168}, {234, 196, 174}, {230, 190, 166}}};
    return paintedTile(Size, [=](double x, double y) {
        const int row = static_cast<int>(y) / 10;
        const double shifted = std::fmod(x + row % 2 * 10, Size);
        const int brick = static_cast<int>(shifted) / 20;
        const double sway = 0.9 * (hills(x, y, Size, 16, 16, 53) - 0.5);
        const double along = shifted - brick * 20 + sway;
        const double down = y - row * 10 + sway;
        const double rough = clouds(x, y, Size, 20, 2, 51) - 0.5;
        const double inward = std::min({along - 0.8, 19.2 - along, down - 0.8, 9.2 - down});
        if (inward < 0) {
            return lit({240, 219, 202}, 14 * rough);
        }
        const double own = chance(brick, row, 52);
        const Shade& clay = clays[static_cast<std::size_t>(own * 4)];
        const bool upper = std::min(along, down) < 2;
        const bool lower = std::max(along - 10, down) > 8;
        return lit(clay, 16 * rough + (inward < 1 ? (upper ? 8 : lower ? -10 : 0) : 0));
    });
}

// ---- 8: Sunlight on the floor of a pool.

Tile water() {
    constexpr int Size = 96;
    const auto points = strewn(Size, 24, 61);
    return paintedTile(Size, [=](double x, double y) {
        const double sway = 4 * std::sin(Turn * 2 * y / Size) + 6 * hills(x, y, Size, 8, 8, 62);
        const double dip = 4 * std::sin(Turn * 2 * x / Size) + 6 * hills(x, y, Size, 8, 8, 63);
        double second = 0;
        const double first = nearest(points, x + sway, y + dip, Size, second);
        // The lines of light swell and fade.
        const double swell = 0.25 + hills(x + 7, y + 5, Size, 7, 7, 64);
        const double light = swell * std::exp(-(second - first) / 2.6);
        const double depth = clouds(x + 3, y + 9, Size, 5, 3, 65);
        return mix(mix({164, 214, 220}, {180, 224, 222}, depth), {236, 252, 246},
                   0.8 * std::min(light, 1.0));
    });
}

// ---- 9: A jumper that somebody has knitted in lilac wool.

Tile knitting() {
    constexpr int Size = 80;
    constexpr double Wide = 10;
    constexpr double High = 8;
    return shadedTile(Size, {190, 174, 216}, {240, 232, 250}, [](double x, double y) {
        const double bentX = x + 1.6 * (hills(x, y, Size, 5, 5, 61) - 0.5) + Size;
        const double bentY = y + 2.4 * (hills(x, y, Size, 5, 5, 62) - 0.5) + Size;
        // Two lobes lean against each other and make a stitch.
        const double across = std::fmod(bentX, Wide / 2) / (Wide / 2);
        const bool right = std::fmod(bentX, Wide) >= Wide / 2;
        const double lean = right ? 1 - across : across;
        const double down = std::fmod(bentY / High - lean * 0.7 + 8, 1.0);
        const double round = std::sin(Turn / 2 * across) * std::sin(Turn / 2 * down);
        const double fuzz = clouds(x, y, Size, 10, 2, 63) - 0.5;
        return 0.3 + 0.42 * std::sqrt(round) + 0.18 * fuzz + (right ? -0.04 : 0.04);
    });
}

// ---- 10: Sand that the wind has combed.

Tile sand() {
    constexpr int Size = 80;
    const Field height = [](double x, double y) {
        const double bend = 16 * hills(x, y, Size, 2, 2, 71) + 5 * hills(x, y, Size, 5, 5, 73);
        const double wave = std::fmod((y + bend) * 8 / Size + 8, 1.0);
        const double ridge = wave < 0.7 ? wave / 0.7 : (1 - wave) / 0.3;
        return ridge * ridge * (3 - 2 * ridge) * (0.5 + hills(x, y, Size, 4, 6, 74));
    };
    return shadedTile(Size, {206, 188, 138}, {250, 242, 204}, [height](double x, double y) {
        const double grain = chance(static_cast<int>(x), static_cast<int>(y), 75) - 0.5;
        return 0.56 + 0.24 * (height(x, y + 1) - height(x, y - 1)) + 0.14 * grain;
    });
}

} // namespace

std::vector<Tile> drawTiles() {
    return {footprints(), terrazzo(), raindrops(), boards(),   shingles(),
            petals(),     bricks(),   water(),     knitting(), sand()};
}

} // namespace art
