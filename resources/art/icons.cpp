#include "resources/art/icons.h"

#include "resources/art/emblem.h"
#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <string>
#include <utility>
#include <vector>

namespace art {

namespace {

// At this size nothing but single pixels will do: cap, nose and one row of eyes.
Picture drawSmallest() {
    Picture picture(16, 16);
    stamp(picture, 0, 0,
          {"    bbbbbbb     ", "  bbCCCCcccbb   ", " bCCCCCCcccccb  ", "bCCCbbbbbbbbbbb ",
           "bCcbYYYYYYYYYYyb", "bbbbbbbbbbbbbbb ", "bRRbWWWbWWWb    ", "bRRbWWbbWWbb    ",
           " bbYWWbbWWbbbb  ", "  bYYbbYbbYYYYb ", "  bYYYYYYbWWYYYb", "  bYRYYYYbYYYYRb",
           "  bYYbYYYbbRRRb ", "   bYYbbbbbbbb  ", "   bbYYYYYYbb   ", "     bbbbbb     "},
          Skin);
    return picture;
}

std::vector<Outline> scaled(std::vector<Outline> outlines, double scale, Point shift) {
    for (Outline& outline : outlines) {
        for (Point& point : outline) {
            point = point * scale + shift;
        }
    }
    return outlines;
}

// Plain shapes in the sixteen colours, with lines of one pixel.
Picture drawShapes(const std::vector<Layer>& layers, int size) {
    Picture picture(size, size);
    for (const Layer& layer : layers) {
        const Part part = {scaled(layer.outlines, size / EmblemSize, {0, 0}), layer.ink, layer.ink,
                           0};
        if (layer.line > 0) {
            paintOutlined(picture, part, Line);
        } else {
            paintWithin(picture, part, coverage(part.outlines, size, size));
        }
    }
    return picture;
}

// ---- The sheet

constexpr double LineWidth = 1.1;

Picture drawSmallestSheet() {
    Picture picture(16, 16);
    stamp(picture, 0, 0,
          {"  bbbbbbbb      ", "  bWWWWWWbb     ", "  bWWWWWWblb    ", "  bWWWWWWbllb   ",
           "  bWbbbbbbbbbb  ", "  bbCCCcccbWWb  ", "  bCcbbbbbbbWb  ", "  bRbYYYYYYYbb  ",
           "  bRRbWWbWWbWb  ", "  bWbYWbbWbbbb  ", "  bWbYYYYbYYYb  ", "  bWbYRYYYYYRb  ",
           "  bWbYYYYYbbbb  ", "  bWWbYYYYYbWb  ", "  bWWWbbbbbWWb  ", "  bbbbbbbbbbbb  "},
          Skin);
    return picture;
}

// A sheet of paper with a corner turned down.
std::vector<Layer> sheetLayers() {
    const Outline sheet = {{8, 2}, {41, 2}, {56, 17}, {56, 62}, {8, 62}};
    const Outline light = {{8, 2}, {41, 2}, {41, 17}, {53.5, 17}, {53.5, 59.5}, {8, 59.5}};
    const Outline corner = {{41, 2}, {41, 17}, {56, 17}};
    return {{{sheet}, LightGrey, LineWidth}, {{light}, White, 0}, {{corner}, LightGrey, LineWidth}};
}

std::vector<Layer> toonIconLayers() {
    constexpr double part = 0.68;
    const Point corner = {10.5, 17};
    std::vector<Layer> layers = sheetLayers();
    for (Layer layer : emblemLayers(false)) {
        layer.outlines = scaled(std::move(layer.outlines), part, corner);
        layers.push_back(std::move(layer));
    }
    return layers;
}

void overlay(Picture& picture, const Picture& upper, int left, int top) {
    for (int y = 0; y < upper.height; ++y) {
        for (int x = 0; x < upper.width; ++x) {
            if (upper.at(x, y) != Black) {
                picture.set(left + x, top + y, upper.at(x, y));
            }
        }
    }
}

} // namespace

Picture drawSmallIcon(int size) {
    if (size == 16) {
        return drawSmallest();
    }
    Picture picture = drawShapes(emblemLayers(true), size);
    const bool large = size == 32;
    const int eyes = size / 2 - (large ? 3 : 2);
    const std::vector<std::string> look =
        large ? std::vector<std::string>{" bbb bbb ", "bWWWbWWWb", "bWWbbWWbb",
                                         "bWWbbWWbb", "bWWWbWWWb", " bbb bbb "}
              : std::vector<std::string>{" bb bb ", "bWWbWWb", "bWWbWWb", "bWbbWbb", " bb bb "};
    const std::vector<std::string> smile =
        large ? std::vector<std::string>{"b     b", " b   b ", "  bbb  "}
              : std::vector<std::string>{"b  b", " bb "};
    stamp(picture, eyes, size * 3 / 8 - 1, look, Skin);
    stamp(picture, size * 9 / 16, size * 25 / 32, smile, Skin);
    return picture;
}

Image drawLargeIcon(int size) {
    return drawLayers(emblemLayers(false), size);
}

std::string iconSvg() {
    return svgOf(emblemLayers(false), "Dorbo");
}

Picture drawSmallToonIcon(int size) {
    if (size == 16) {
        return drawSmallestSheet();
    }
    Picture picture = drawShapes(sheetLayers(), size);
    const Picture head = drawSmallIcon(size == 32 ? 22 : 16);
    overlay(picture, head, (size - head.width) / 2, size - head.height - 2);
    return picture;
}

Image drawLargeToonIcon(int size) {
    return drawLayers(toonIconLayers(), size);
}

std::string toonIconSvg() {
    return svgOf(toonIconLayers(), "A Toon");
}

} // namespace art
