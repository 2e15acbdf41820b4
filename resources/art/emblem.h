#pragma once

#include "resources/art/image.h"
#include "resources/art/outline.h"
#include "resources/art/painter.h"

#include <string>
#include <vector>

namespace art {

// The emblem is his head, half to the right, in a square of this size.
constexpr double EmblemSize = 64;

// Everything inside any of the outlines in one colour, on top of a line round all of them.
struct Layer {
    std::vector<Outline> outlines;
    Ink ink = White;
    // How far the line reaches outwards; 0 for none.
    double line = 0;
};

// The layers from the back to the front. The plain ones leave out the ear, for which a small
// picture has no room, and eyes and mouth, which it has pixel by pixel.
std::vector<Layer> emblemLayers(bool plain);

// Layers with smooth edges, a square of so many pixels.
Image drawLayers(const std::vector<Layer>& layers, int size);

// Layers as the text of an SVG file.
std::string svgOf(const std::vector<Layer>& layers, const std::string& title);

} // namespace art
