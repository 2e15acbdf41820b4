#include "resources/art/gallery.h"

#include "resources/art/bmp_file.h"
#include "resources/art/bubbles.h"
#include "resources/art/buttons.h"
#include "resources/art/expressions.h"
#include "resources/art/icons.h"
#include "resources/art/png_file.h"
#include "resources/art/poses.h"
#include "resources/art/target.h"
#include "resources/art/tiles.h"
#include "resources/art/walk.h"

#include <iterator>
#include <stdexcept>
#include <utility>

namespace art {

namespace {

std::string bitmapFile(const std::string& name) {
    return "bitmaps/" + name + ".bmp";
}

Exhibit sixteenColours(const std::string& name, const Picture& picture) {
    return {bitmapFile(name), bmpBytes(picture, SixteenColours, {4, 0})};
}

void addWalks(std::vector<Exhibit>& gallery) {
    for (int i = 1; i <= WalkCount; ++i) {
        const Figure right = walkingRight(i);
        gallery.push_back(sixteenColours("fdl2r" + std::to_string(i), drawFigure(right)));
        gallery.push_back(sixteenColours("fdr2l" + std::to_string(i), drawFigure(mirrored(right))));
    }
}

void addTurns(std::vector<Exhibit>& gallery) {
    for (int i = 1; i <= 2; ++i) {
        const Figure right = turningRight(i);
        gallery.push_back(sixteenColours("fdltn" + std::to_string(i), drawFigure(right)));
        gallery.push_back(sixteenColours("fdrtn" + std::to_string(i), drawFigure(mirrored(right))));
    }
}

void addPoses(std::vector<Exhibit>& gallery) {
    for (int i = 0; i < PoseCount; ++i) {
        gallery.push_back(sixteenColours("pose0" + std::to_string(i + 1), drawFigure(pose(i))));
    }
}

void addTiles(std::vector<Exhibit>& gallery) {
    // The form of each, from the first on.
    constexpr BmpForm Forms[] = {{4, 0}, {8, 0},   {8, 0},   {8, 0},   {8, 0},
                                 {8, 0}, {8, 256}, {8, 256}, {8, 256}, {8, 256}};
    const std::vector<Tile> tiles = drawTiles();
    if (tiles.size() != std::size(Forms)) {
        throw std::logic_error("there aren't as many forms as tiles");
    }
    for (std::size_t i = 0; i < tiles.size(); ++i) {
        const std::string name = (i < 9 ? "bg0" : "bg") + std::to_string(i + 1);
        gallery.push_back(
            {bitmapFile(name), bmpBytes(tiles[i].picture, tiles[i].colours, Forms[i])});
    }
}

void addIcons(std::vector<Exhibit>& gallery) {
    const auto add = [&gallery](const std::string& name, int size, const Image& image) {
        gallery.push_back({"icons/" + name + std::to_string(size) + ".png", pngBytes(image)});
    };
    for (const int size : SmallIcons) {
        add("", size, trueColours(drawSmallIcon(size)));
        add("toon-", size, trueColours(drawSmallToonIcon(size)));
    }
    for (const int size : LargeIcons) {
        add("", size, drawLargeIcon(size));
        add("toon-", size, drawLargeToonIcon(size));
    }
    for (const auto& [name, svg] : {std::pair("dorbo", iconSvg()), {"toon", toonIconSvg()}}) {
        gallery.push_back({std::string("icons/") + name + ".svg", {svg.begin(), svg.end()}});
    }
}

} // namespace

std::vector<Exhibit> drawGallery() {
    std::vector<Exhibit> gallery;
    addWalks(gallery);
    addTurns(gallery);
    addPoses(gallery);
    gallery.push_back(sixteenColours("bubleft", drawBubble(Tail::Left)));
    gallery.push_back(sixteenColours("bubright", drawBubble(Tail::Right)));
    gallery.push_back(sixteenColours("expresns", drawExpressions()));
    addTiles(gallery);
    gallery.push_back(sixteenColours("sysbuts", drawSysButtons()));
    addIcons(gallery);
    gallery.push_back({"cursors/target.cur", targetCursor()});
    return gallery;
}

} // namespace art
