#include "resources/art/bubbles.h"

#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <cmath>
#include <cstddef>

namespace art {

namespace {

constexpr int Width = 160;
constexpr int Height = 95;

// A place on the rim of the white, and how thick the line is that goes round it there.
struct Stroke {
    Point at;
    double line;
};

// With the tail at the left, clockwise from the upper left. The text takes the columns 30 to 149
// and the rows from 26 down to the last but one, so the bottom can't but be straight.
// A place told twice is a corner.
const std::vector<Stroke> Balloon = {
    {{33, 9.5}, 1.8},   {{46, 4.6}, 1.2},   {{72, 3.2}, 1.6},    {{98, 1.2}, 1.1},
    {{124, 2.4}, 1.2},  {{141, 5.2}, 1.9},  {{151.5, 13}, 2.5},  {{155.6, 26}, 1.9},
    {{156.4, 46}, 1.2}, {{156.8, 63}, 1.7}, {{155.4, 79}, 2.5},  {{152.6, 89}, 2.5},
    {{149, 94}, 1.6},   {{120, 94}, 1.0},   {{60, 94}, 1.0},     {{31, 94}, 1.2},
    {{25.8, 88}, 2.2},  {{23.4, 79}, 1.8},  {{21.8, 71}, 1.2},   {{21.8, 71}, 1.2},
    {{14, 67}, 1.6},    {{6, 60}, 1.9},     {{0.4, 50.6}, 1.0},  {{0.4, 50.6}, 1.0},
    {{7, 54.2}, 1.2},   {{14, 54.8}, 1.2},  {{20.4, 51.5}, 1.0}, {{20.4, 51.5}, 1.0},
    {{20.8, 41}, 1.2},  {{22.2, 28}, 1.9},  {{26, 17}, 2.3}};

// The shade, as lens shapes along the rim: of the bubble with the tail at the left, and of the
// other as it stands.
const std::vector<Outline> ShadeLeft = {
    blob({{156.8, 30}, {158.5, 60}, {157, 84}, {151, 94.5}, {150, 90}, {152.2, 80}, {154.2, 60}}),
    blob({{22, 72}, {13, 67.5}, {6, 60}, {2, 53}, {7, 58.5}, {14, 64.5}})};
const std::vector<Outline> ShadeRight = {
    blob({{138.6, 70}, {139, 80}, {134, 94}, {130.2, 94.5}, {130.2, 90}, {134, 80}}),
    blob({{138, 24}, {140.5, 40}, {140.4, 52}, {138.4, 44}}),
    blob({{158, 53}, {154, 60}, {146, 67.5}, {138.4, 72}, {146, 64.5}, {153, 58.5}})};

Outline rim() {
    std::vector<Point> through;
    through.reserve(Balloon.size());
    for (const Stroke& stroke : Balloon) {
        through.push_back(stroke.at);
    }
    return blob(through);
}

// The rim moved outwards by the thickness of the line.
Outline outerRim() {
    std::vector<Point> lines;
    lines.reserve(Balloon.size());
    for (const Stroke& stroke : Balloon) {
        lines.push_back({stroke.line, 0});
    }
    const Outline inner = rim();
    const Outline thickness = blob(lines);
    Outline outer;
    for (std::size_t i = 0; i < inner.size(); ++i) {
        const Point way =
            inner[(i + 1) % inner.size()] - inner[(i + inner.size() - 1) % inner.size()];
        const double length = std::hypot(way.x, way.y);
        if (length > 0.01) {
            outer.push_back(inner[i] + Point{way.y, -way.x} * (thickness[i].x / length));
        }
    }
    return outer;
}

Outline facing(Outline outline, Tail tail) {
    for (Point& point : outline) {
        point.x = tail == Tail::Left ? point.x : Width - point.x;
    }
    return outline;
}

} // namespace

Picture drawBubble(Tail tail) {
    Picture picture(Width, Height);
    const Mask whole = coverage({facing(outerRim(), tail)}, Width, Height);
    paintWithin(picture, {{facing(outerRim(), tail)}, Line, Line, 0}, whole);
    const Mask inside = paintOutlined(picture, {{facing(rim(), tail)}, White, White, 0}, Line);
    const std::vector<Outline>& shade = tail == Tail::Left ? ShadeLeft : ShadeRight;
    paintWithin(picture, {shade, LightGrey, LightGrey, 0}, inside);
    return picture;
}

} // namespace art
