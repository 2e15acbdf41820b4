#pragma once

#include "resources/art/picture.h"

#include <array>
#include <cstdint>
#include <functional>
#include <vector>

namespace art {

// A picture that repeats without a seam, with colours of its own.
struct Tile {
    Picture picture;
    std::vector<Rgb> colours;
};

// A number for each place of a tile; it must repeat with the tile's size.
using Field = std::function<double(double x, double y)>;

// Soft hills between 0 and 1 that repeat after `size` pixels, with `cells` hills across and `rows`
// down.
double hills(double x, double y, int size, int cells, int rows, std::uint32_t seed);

// Several layers of hills, each twice as fine and half as high as the one before; between 0 and 1.
double clouds(double x, double y, int size, int cells, int layers, std::uint32_t seed);

// A number from 0 to 1 that looks like chance and depends on the arguments alone.
double chance(int x, int y, std::uint32_t seed);

// How far the place is from the nearest of the points, in a tile that repeats; second gets the
// distance to the next nearest.
double nearest(const std::vector<std::array<double, 2>>& points, double x, double y, int size,
               double& second);

// One point in each field of a grid, moved about by chance.
std::vector<std::array<double, 2>> scattered(int size, int cells, std::uint32_t seed);

// 256 steps from one colour to another.
std::vector<Rgb> ramp(Rgb dark, Rgb light);

// Turns a field of 0 to 1 into a tile of 256 colours.
Tile shadedTile(int size, Rgb dark, Rgb light, const Field& brightness);

// A colour in the making, each part from 0 to 255.
struct Shade {
    double red = 0;
    double green = 0;
    double blue = 0;
};

Shade mix(Shade a, Shade b, double share);
// Lighter by so much in each part, or darker.
Shade lit(Shade shade, double by);

// Paints every place of a tile; places next to each other may differ as they like, since each pixel
// takes the mean of several. The colours are taken as fine as fits into the tile's table.
Tile paintedTile(int size, const std::function<Shade(double x, double y)>& paint);

// So many points that keep away from each other, also across the edges.
std::vector<std::array<double, 2>> strewn(int size, int count, std::uint32_t seed);

// The way from a to b across the nearest edge, if that is shorter: between -size / 2 and size / 2.
double shortestWay(double a, double b, int size);

// A field seen as a landscape in light from the upper left: 0.5 where it is flat.
Field relief(const Field& height, double strength);

} // namespace art
