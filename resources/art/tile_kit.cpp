#include "resources/art/tile_kit.h"

#include <algorithm>
#include <cmath>
#include <cstddef>

namespace art {

namespace {

double smooth(double t) {
    return t * t * (3 - 2 * t);
}

int wrapped(int value, int count) {
    return ((value % count) + count) % count;
}

// How many samples stand for a pixel in each direction.
constexpr int Samples = 4;

Shade sampled(const std::function<Shade(double x, double y)>& paint, int x, int y) {
    Shade sum;
    for (int i = 0; i < Samples * Samples; ++i) {
        const int column = i % Samples;
        const int row = i / Samples;
        const Shade shade = paint(x + (column + 0.5) / Samples, y + (row + 0.5) / Samples);
        sum = {sum.red + shade.red, sum.green + shade.green, sum.blue + shade.blue};
    }
    return mix({}, sum, 1.0 / (Samples * Samples));
}

std::uint8_t rounded(double part, int step) {
    return static_cast<std::uint8_t>(std::clamp(std::lround(part / step) * step, 0L, 255L));
}

// The colours in steps of so much, as numbers: red, green and blue one above the other.
std::vector<std::uint32_t> stepped(const std::vector<Shade>& shades, int step) {
    std::vector<std::uint32_t> numbers;
    numbers.reserve(shades.size());
    for (const Shade& shade : shades) {
        numbers.push_back(rounded(shade.red, step) * 65536U + rounded(shade.green, step) * 256U +
                          rounded(shade.blue, step));
    }
    return numbers;
}

std::vector<std::uint32_t> different(std::vector<std::uint32_t> numbers) {
    std::sort(numbers.begin(), numbers.end());
    numbers.erase(std::unique(numbers.begin(), numbers.end()), numbers.end());
    return numbers;
}

std::uint8_t blend(std::uint8_t from, std::uint8_t to, double share) {
    return static_cast<std::uint8_t>(std::lround(from + (to - from) * share));
}

} // namespace

double chance(int x, int y, std::uint32_t seed) {
    std::uint32_t mixed = seed * 747796405U + static_cast<std::uint32_t>(x) * 2654435769U +
                          static_cast<std::uint32_t>(y) * 2246822519U;
    mixed = (mixed ^ (mixed >> 15U)) * 2654435761U;
    mixed = (mixed ^ (mixed >> 13U)) * 3266489917U;
    mixed ^= mixed >> 16U;
    return mixed / 4294967296.0;
}

double hills(double x, double y, int size, int cells, int rows, std::uint32_t seed) {
    const double gx = x * cells / size;
    const double gy = y * rows / size;
    const int left = static_cast<int>(std::floor(gx));
    const int top = static_cast<int>(std::floor(gy));
    const auto corner = [&](int dx, int dy) {
        return chance(wrapped(left + dx, cells), wrapped(top + dy, rows), seed);
    };
    const double tx = smooth(gx - left);
    const double ty = smooth(gy - top);
    const double upper = corner(0, 0) + (corner(1, 0) - corner(0, 0)) * tx;
    const double lower = corner(0, 1) + (corner(1, 1) - corner(0, 1)) * tx;
    return upper + (lower - upper) * ty;
}

double clouds(double x, double y, int size, int cells, int layers, std::uint32_t seed) {
    double sum = 0;
    double whole = 0;
    double height = 1;
    for (int layer = 0; layer < layers; ++layer) {
        sum += height * hills(x, y, size, cells << layer, cells << layer,
                              seed + static_cast<std::uint32_t>(layer));
        whole += height;
        height /= 2;
    }
    return sum / whole;
}

double nearest(const std::vector<std::array<double, 2>>& points, double x, double y, int size,
               double& second) {
    double first = size;
    second = size;
    for (const auto& point : points) {
        const double gap =
            std::hypot(shortestWay(point[0], x, size), shortestWay(point[1], y, size));
        second = std::min(second, std::max(gap, first));
        first = std::min(first, gap);
    }
    return first;
}

std::vector<std::array<double, 2>> scattered(int size, int cells, std::uint32_t seed) {
    std::vector<std::array<double, 2>> points;
    const double field = static_cast<double>(size) / cells;
    for (int row = 0; row < cells; ++row) {
        for (int column = 0; column < cells; ++column) {
            points.push_back({(column + chance(column, row, seed)) * field,
                              (row + chance(column, row, seed + 1)) * field});
        }
    }
    return points;
}

std::vector<Rgb> ramp(Rgb dark, Rgb light) {
    std::vector<Rgb> colours;
    for (int i = 0; i < 256; ++i) {
        const double share = i / 255.0;
        colours.push_back({blend(dark.red, light.red, share), blend(dark.green, light.green, share),
                           blend(dark.blue, light.blue, share)});
    }
    return colours;
}

Tile shadedTile(int size, Rgb dark, Rgb light, const Field& brightness) {
    Tile tile{Picture(size, size), ramp(dark, light)};
    for (int y = 0; y < size; ++y) {
        for (int x = 0; x < size; ++x) {
            const double value = std::clamp(brightness(x, y), 0.0, 1.0);
            tile.picture.set(x, y, static_cast<std::uint8_t>(std::lround(value * 255)));
        }
    }
    return tile;
}

Shade mix(Shade a, Shade b, double share) {
    return {a.red + (b.red - a.red) * share, a.green + (b.green - a.green) * share,
            a.blue + (b.blue - a.blue) * share};
}

Shade lit(Shade shade, double by) {
    return {shade.red + by, shade.green + by, shade.blue + by};
}

Tile paintedTile(int size, const std::function<Shade(double x, double y)>& paint) {
    constexpr std::size_t Colours = 256;
    // A screen or a film of 256 colours has to find room for the figure's beside them.
    constexpr std::size_t Painted = 224;
    std::vector<Shade> shades;
    shades.reserve(static_cast<std::size_t>(size * size));
    for (int i = 0; i < size * size; ++i) {
        shades.push_back(sampled(paint, i % size, i / size));
    }
    int step = 1;
    while (different(stepped(shades, step)).size() > Painted) {
        ++step;
    }
    const std::vector<std::uint32_t> numbers = stepped(shades, step);
    const std::vector<std::uint32_t> palette = different(numbers);
    Tile tile{Picture(size, size), std::vector<Rgb>(Colours)};
    for (std::size_t i = 0; i < palette.size(); ++i) {
        tile.colours[i] = {static_cast<std::uint8_t>(palette[i] >> 16U),
                           static_cast<std::uint8_t>(palette[i] >> 8U),
                           static_cast<std::uint8_t>(palette[i])};
    }
    for (std::size_t i = 0; i < numbers.size(); ++i) {
        const auto found = std::lower_bound(palette.begin(), palette.end(), numbers[i]);
        tile.picture.pixels[i] = static_cast<std::uint8_t>(found - palette.begin());
    }
    return tile;
}

double shortestWay(double a, double b, int size) {
    return std::remainder(b - a, static_cast<double>(size));
}

std::vector<std::array<double, 2>> strewn(int size, int count, std::uint32_t seed) {
    constexpr int Tries = 24;
    std::vector<std::array<double, 2>> points;
    for (int i = 0; i < count; ++i) {
        std::array<double, 2> best = {};
        double widest = -1;
        for (int attempt = 0; attempt < Tries; ++attempt) {
            const double x = size * chance(i, attempt, seed);
            const double y = size * chance(i, attempt, seed + 1);
            double second = 0;
            const double gap = nearest(points, x, y, size, second);
            if (gap > widest) {
                widest = gap;
                best = {x, y};
            }
        }
        points.push_back(best);
    }
    return points;
}

Field relief(const Field& height, double strength) {
    return [height, strength](double x, double y) {
        return 0.5 + strength * (height(x + 1, y + 1) - height(x - 1, y - 1));
    };
}

} // namespace art
