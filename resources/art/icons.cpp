#include "resources/art/icons.h"

#include "resources/art/emblem.h"
#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <string>
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

// The emblem's plain shapes in the sixteen colours, with lines of one pixel.
Picture drawShapes(int size, double scale, Point shift) {
    Picture picture(size, size);
    for (const Layer& layer : emblemLayers(true)) {
        const Part part = {scaled(layer.outlines, scale, shift), layer.ink, layer.ink, 0};
        if (layer.line > 0) {
            paintOutlined(picture, part, Line);
        } else {
            paintWithin(picture, part, coverage(part.outlines, size, size));
        }
    }
    return picture;
}

} // namespace

Picture drawSmallIcon(int size) {
    if (size == 16) {
        return drawSmallest();
    }
    Picture picture = drawShapes(size, size / EmblemSize, {0, 0});
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

} // namespace art
