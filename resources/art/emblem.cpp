#include "resources/art/emblem.h"

#include "resources/art/wardrobe.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstdio>

#include <utility>

namespace art {

namespace {

constexpr double LineWidth = 1.1;
// Where the light falls on the cap, so that it stands out on dark ground.
constexpr Ink Shine = {Cyan, DarkCyan};

// A shape that can be drawn smaller all round; the light is such a smaller one, up and left.
struct Round {
    Point from;
    Point to;
    double fromRadius;
    double toRadius;
};

Outline roundOutline(const Round& shape, double inset) {
    const Point shift = {-0.6 * inset, -0.6 * inset};
    return bone(shape.from + shift, shape.to + shift, shape.fromRadius - inset,
                shape.toRadius - inset);
}

// Round things in the light, with a line round all of them.
void addLit(std::vector<Layer>& layers, const std::vector<Round>& shapes, Ink lit, Ink shade,
            double shadow) {
    Layer whole{{}, shade, LineWidth};
    Layer light{{}, lit, 0};
    for (const Round& shape : shapes) {
        whole.outlines.push_back(roundOutline(shape, 0));
        light.outlines.push_back(roundOutline(shape, shadow));
    }
    layers.push_back(std::move(whole));
    layers.push_back(std::move(light));
}

void addHair(std::vector<Layer>& layers) {
    addLit(layers,
           {{{14.6, 23.6}, {15, 25}, 4.8, 4.4},
            {{13.5, 31}, {13.5, 31}, 4.2, 4.2},
            {{14.5, 37}, {14.5, 37}, 3.6, 3.6}},
           Hair, HairShade, 0.9);
}

void addFace(std::vector<Layer>& layers) {
    const std::vector<Point> whole = {{31, 14}, {47, 20}, {46.5, 30}, {49, 42},
                                      {51, 51}, {46, 58}, {37, 61},   {27, 57.5},
                                      {20, 48}, {17, 38}, {16, 22}};
    const std::vector<Point> light = {{31, 14},   {46, 20},   {45, 30},   {47, 42},
                                      {48.4, 50}, {43.8, 56}, {36, 58.6}, {27, 55.5},
                                      {20, 47},   {17, 37},   {16, 22}};
    layers.push_back({{blob(whole)}, SkinShade, LineWidth});
    layers.push_back({{blob(light)}, Skin, 0});
    layers.push_back({{ellipse({26, 45}, 4.2, 3.6)}, Blush, 0});
}

void addEar(std::vector<Layer>& layers) {
    addLit(layers, {{{19.5, 32}, {19.5, 34}, 3.9, 3.9}}, Skin, SkinShade, 0.9);
}

// The dome and, hanging down behind it, the tip.
void addCap(std::vector<Layer>& layers) {
    addLit(layers,
           {{{22, 9.5}, {14, 10.5}, 6.2, 5},
            {{14, 10.5}, {8.5, 16}, 5, 3.8},
            {{8.5, 16}, {6.8, 23}, 3.8, 2.6}},
           Felt, FeltShade, 1.5);
    const std::size_t light = layers.size() - 1;
    const std::vector<Point> dome = {{14, 18}, {16, 8},  {24, 3.4}, {36, 3.4},
                                     {45, 8},  {50, 17}, {32, 19}};
    const std::vector<Point> lit = {{14, 18}, {16, 8},    {24, 3.4}, {35, 3.4},
                                    {43, 8},  {47.5, 17}, {31, 18.5}};
    layers[light - 1].outlines.push_back(blob(dome));
    layers[light].outlines.push_back(blob(lit));
    layers.push_back({tube({{14.5, 11.8}, {18.5, 8}, {24.5, 5.8}, {31, 5.4}}, 1.2, 1.6), Shine, 0});
    addLit(layers, {{{6.6, 27.5}, {6.6, 27.5}, 5, 5}}, Bobble, BobbleShade, 1.2);
    addLit(layers, {{{17, 19.5}, {49, 17.5}, 3.6, 3.6}}, Trim, TrimShade, 0.9);
}

void addNose(std::vector<Layer>& layers, Ink shade, double shadow) {
    addLit(layers, {{{41, 34}, {46, 40}, 4, 7}, {{43.5, 40.5}, {51, 40}, 6.6, 7.4}}, Skin, shade,
           shadow);
    layers.push_back({{ellipse({46.6, 37.4}, 3, 2.1, -25)}, White, 0});
}

void addEye(std::vector<Layer>& layers, double x) {
    layers.push_back({{ellipse({x, 29.5}, 3.7, 5)}, White, LineWidth});
    layers.push_back({{ellipse({x + 1.4, 30.2}, 1.9, 2.9)}, Line, 0});
    layers.push_back({{ellipse({x + 0.9, 29}, 0.7, 0.9)}, White, 0});
}

void addFeatures(std::vector<Layer>& layers) {
    addEye(layers, 31.5);
    addEye(layers, 39.8);
    layers.push_back({tube({{35, 50}, {39, 53.2}, {44, 52.8}, {46.5, 50.4}}, 0.8, 0.8), Line, 0});
    layers.push_back({tube({{34.2, 49.4}, {35, 50}, {34.6, 51.2}}, 0.7, 0.7), Line, 0});
}

// ---- Smooth pictures

// So many samples stand for a pixel in each direction.
constexpr int Samples = 4;

void fillOutline(Mask& mask, const Outline& outline, double scale) {
    for (int y = 0; y < mask.height; ++y) {
        const double level = (y + 0.5) / scale;
        std::vector<double> crossings;
        for (std::size_t i = 0; i < outline.size(); ++i) {
            const Point a = outline[i];
            const Point b = outline[(i + 1) % outline.size()];
            if ((a.y <= level) != (b.y <= level)) {
                crossings.push_back(a.x + (b.x - a.x) * (level - a.y) / (b.y - a.y));
            }
        }
        std::sort(crossings.begin(), crossings.end());
        for (std::size_t i = 0; i + 1 < crossings.size(); i += 2) {
            const int from = static_cast<int>(std::ceil(crossings[i] * scale - 0.5));
            const int to = static_cast<int>(std::ceil(crossings[i + 1] * scale - 0.5));
            for (int x = std::max(from, 0); x < std::min(to, mask.width); ++x) {
                mask.set(x, y, 1);
            }
        }
    }
}

// The pixels of the mask and those within the radius round it.
Mask widened(const Mask& mask, double radius) {
    Mask wide = mask;
    const int reach = static_cast<int>(std::ceil(radius));
    for (int y = 0; y < mask.height; ++y) {
        for (int x = 0; x < mask.width; ++x) {
            const int sides =
                mask.at(x - 1, y) + mask.at(x + 1, y) + mask.at(x, y - 1) + mask.at(x, y + 1);
            if (mask.at(x, y) == 0 || sides == 4) {
                continue;
            }
            for (int i = 0; i < (2 * reach + 1) * (2 * reach + 1); ++i) {
                const int dx = i % (2 * reach + 1) - reach;
                const int dy = i / (2 * reach + 1) - reach;
                if (dx * dx + dy * dy <= radius * radius) {
                    wide.set(x + dx, y + dy, 1);
                }
            }
        }
    }
    return wide;
}

void fillMask(Image& image, const Mask& mask, Rgba colour) {
    for (std::size_t i = 0; i < mask.pixels.size(); ++i) {
        if (mask.pixels[i] != 0) {
            image.pixels[i] = colour;
        }
    }
}

// The mean of a square of samples, each as heavy as it is solid.
Rgba mean(const Image& fine, int left, int top) {
    int sums[4] = {};
    for (int i = 0; i < Samples * Samples; ++i) {
        const Rgba& sample = fine.at(left + i % Samples, top + i / Samples);
        const int weight = sample.alpha != 0 ? 1 : 0;
        sums[0] += sample.red * weight;
        sums[1] += sample.green * weight;
        sums[2] += sample.blue * weight;
        sums[3] += weight;
    }
    if (sums[3] == 0) {
        return {};
    }
    const auto share = [](int sum, int count) {
        return static_cast<std::uint8_t>((sum + count / 2) / count);
    };
    return {share(sums[0], sums[3]), share(sums[1], sums[3]), share(sums[2], sums[3]),
            share(sums[3] * 255, Samples * Samples)};
}

// ---- SVG

// Points that lie closer than this add nothing to a path.
constexpr double ShortestStep = 0.6;

std::string number(double value) {
    char text[32];
    std::snprintf(text, sizeof text, "%.2f", value);
    return text;
}

std::string pathOf(const std::vector<Outline>& outlines) {
    std::string path;
    for (const Outline& outline : outlines) {
        char letter = 'M';
        Point last = {-EmblemSize, -EmblemSize};
        for (const Point& point : outline) {
            if (distance(point, last) >= ShortestStep) {
                path += letter + number(point.x) + ' ' + number(point.y);
                letter = 'L';
                last = point;
            }
        }
        path += 'Z';
    }
    return path;
}

std::string colourName(Ink ink) {
    const Rgba colour = blended(ink);
    char text[16];
    std::snprintf(text, sizeof text, "#%02x%02x%02x", static_cast<unsigned>(colour.red),
                  static_cast<unsigned>(colour.green), static_cast<unsigned>(colour.blue));
    return text;
}

} // namespace

std::vector<Layer> emblemLayers(bool plain) {
    std::vector<Layer> layers;
    addHair(layers);
    addFace(layers);
    if (!plain) {
        addEar(layers);
    }
    addCap(layers);
    addNose(layers, plain ? Ink(Red) : Blush, plain ? 1.1 : 1.7);
    if (!plain) {
        addFeatures(layers);
    }
    return layers;
}

Image drawLayers(const std::vector<Layer>& layers, int size) {
    const int side = size * Samples;
    const double scale = side / EmblemSize;
    Image fine(side, side);
    for (const Layer& layer : layers) {
        Mask mask(side, side);
        for (const Outline& outline : layer.outlines) {
            fillOutline(mask, outline, scale);
        }
        if (layer.line > 0) {
            fillMask(fine, widened(mask, layer.line * scale), blended(Line));
        }
        fillMask(fine, mask, blended(layer.ink));
    }
    Image image(size, size);
    for (int y = 0; y < size; ++y) {
        for (int x = 0; x < size; ++x) {
            image.at(x, y) = mean(fine, x * Samples, y * Samples);
        }
    }
    return image;
}

std::string svgOf(const std::vector<Layer>& layers, const std::string& title) {
    std::string text = "<svg xmlns=\"http://www.w3.org/2000/svg\" width=\"64\" height=\"64\" "
                       "viewBox=\"0 0 64 64\">\n<title>" +
                       title + "</title>\n";
    for (const Layer& layer : layers) {
        const std::string path = pathOf(layer.outlines);
        if (layer.line > 0) {
            text += "<path fill=\"" + colourName(Line) + "\" stroke=\"" + colourName(Line) +
                    "\" stroke-width=\"" + number(2 * layer.line) +
                    "\" stroke-linejoin=\"round\" d=\"" + path + "\"/>\n";
        }
        text += "<path fill=\"" + colourName(layer.ink) + "\" d=\"" + path + "\"/>\n";
    }
    return text + "</svg>\n";
}

} // namespace art
