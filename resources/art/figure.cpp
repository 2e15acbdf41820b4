#include "resources/art/figure.h"

#include "resources/art/painter.h"

#include <cmath>
#include <utility>

namespace art {

namespace {

constexpr Colour Line = DarkBlue;
constexpr Ink Cloth = DarkCyan;
constexpr Ink ClothShade = {DarkCyan, DarkBlue};

constexpr double UpperArm = 19;
constexpr double LowerArm = 18;
constexpr double Thigh = 26;
constexpr double Shin = 25;

// Places on the trunk: `down` goes from 0 at the neck to 1 at the pelvis, `aside` is in pixels to
// the right.
struct Trunk {
    Point neck;
    Point pelvis;

    Point operator()(double aside, double down) const {
        const Point axis = pelvis - neck;
        const double length = std::hypot(axis.x, axis.y);
        const Point across = {axis.y / length, -axis.x / length};
        return neck + axis * down + across * aside;
    }
};

Trunk trunkOf(const Figure& figure) {
    return {figure.neck, figure.pelvis};
}

Point shoulder(const Figure& figure, std::size_t which) {
    const double aside = 11.5 - 9 * figure.turn;
    return trunkOf(figure)(which == 0 ? -aside : aside, 0.16) - Point{0, figure.shoulderLift};
}

Point hip(const Figure& figure, std::size_t which) {
    const double aside = 6.5 - 5.5 * figure.turn;
    return figure.pelvis + Point{which == 0 ? -aside : aside, -4};
}

std::vector<Outline> placed(std::vector<Outline> outlines, Point at, double degrees, double flip) {
    for (Outline& outline : outlines) {
        for (Point& point : outline) {
            point = at + turned({point.x, point.y * flip}, degrees);
        }
    }
    return outlines;
}

// A hand at the origin with its fingers to the right and the thumb below.
std::vector<Outline> handOutlines(Grip grip) {
    switch (grip) {
    case Grip::Relaxed:
        return {ellipse({4.5, 0}, 5.2, 4.4), bone({6, -1.5}, {9.5, -0.5}, 2.6, 2.2),
                bone({3, 2}, {6.5, 5.6}, 1.9, 1.7)};
    case Grip::Open:
        return {ellipse({4.5, 0}, 4.8, 4.5), bone({6, -2}, {11.5, -6}, 1.9, 1.7),
                bone({7, 0}, {13.5, -0.5}, 1.9, 1.7), bone({6, 1.5}, {12, 5}, 1.9, 1.7),
                bone({3, 2}, {4, 8.5}, 1.9, 1.7)};
    case Grip::Pointing:
        return {ellipse({4.5, 0}, 4.8, 4.6), bone({6, -2}, {15.5, -2.5}, 2, 1.7),
                bone({3, 2}, {6, 6.4}, 1.9, 1.7)};
    case Grip::Fist:
        return {ellipse({4.2, 0}, 5.2, 5), bone({4, 3}, {7.5, 3.5}, 2, 1.8)};
    }
    return {};
}

void paintArm(Picture& picture, const Figure& figure, std::size_t which) {
    const Arm& arm = figure.arms[which];
    const Point root = shoulder(figure, which);
    const Point elbow = joint(root, arm.wrist, UpperArm, LowerArm, arm.bend);
    const Part hand = {placed(handOutlines(arm.grip), arm.wrist, arm.angle, arm.thumb), White,
                       LightGrey, 2};
    paintOutlined(picture, hand, Line);
    const Part sleeve = {tube({root, elbow, arm.wrist}, 5.4, 4.2), Red, DarkRed, 2};
    paintOutlined(picture, sleeve, Line);
    const Point along = turned({1, 0}, arm.angle);
    const Point across = {-along.y, along.x};
    const Point end = arm.wrist + along * 0.5;
    paintOutlined(picture,
                  {{bone(end - across * 3, end + across * 3, 2, 2)}, Yellow, DarkYellow, 1}, Line);
}

void paintShoe(Picture& picture, const Leg& leg) {
    const double side = leg.toe < 0 ? -1 : 1;
    const double length = std::fabs(leg.toe);
    Outline sole = {{-6.5, 1}, {-4.5, -3.5}, {1, -4.5}, {5, -2}, {10, -2.5},
                    {14.5, 0}, {15.5, 4},    {13, 6},   {3, 6},  {-5, 6}};
    for (Point& point : sole) {
        point = leg.ankle + turned({point.x * side * length, point.y}, leg.angle * side);
    }
    paintOutlined(picture, {{blob(sole)}, Yellow, DarkYellow, 2}, Line);
}

void paintLeg(Picture& picture, const Figure& figure, std::size_t which) {
    const Leg& leg = figure.legs[which];
    const Point root = hip(figure, which);
    const Point knee = joint(root, leg.ankle, Thigh, Shin, leg.bend);
    paintShoe(picture, leg);
    const bool far = which == 0 && figure.turn > 0.5;
    const Part trouser = {tube({root, knee, leg.ankle - Point{0, 1}}, 7, 4.6),
                          far ? ClothShade : Cloth, ClothShade, 2};
    paintOutlined(picture, trouser, Line);
}

std::vector<Outline> coatOutlines(const Figure& figure) {
    const Trunk at = trunkOf(figure);
    const double slim = 1 - 0.22 * figure.turn;
    const double lift = figure.shoulderLift / 40;
    std::vector<Outline> outlines = {
        blob({at(0, -0.02), at(9 * slim, 0.02 - lift), at(14 * slim, 0.14 - lift),
              at(13.5 * slim, 0.5), at(15 * slim, 0.95), at(13 * slim, 1.12), at(0, 1.16),
              at(-13 * slim, 1.12), at(-15 * slim, 0.95), at(-13.5 * slim, 0.5),
              at(-14 * slim, 0.14 - lift), at(-9 * slim, 0.02 - lift)})};
    if (figure.tails > 0) {
        const std::vector<Point> hang = {at(-7, 0.7), at(-10 - figure.tails * 0.3, 1.0),
                                         at(-9 - figure.tails, 1.3)};
        for (Outline& outline : tube(hang, 8, 4)) {
            outlines.push_back(std::move(outline));
        }
    }
    return outlines;
}

void paintCoat(Picture& picture, const Figure& figure) {
    const Trunk at = trunkOf(figure);
    const Mask coat = paintOutlined(picture, {coatOutlines(figure), Red, DarkRed, 3}, Line);
    const double seam = 8 * figure.turn;
    paintWithin(picture, {{bone(at(seam, 0), at(seam, 1.3), 0.55, 0.55)}, DarkRed, DarkRed, 0},
                coat);
    for (const double down : {0.32, 0.56, 0.8}) {
        paintWithin(picture, {{ellipse(at(seam + 3.2, down), 1.7, 1.7)}, Yellow, DarkYellow, 1},
                    coat);
    }
    const Point collar = at(1.5 * figure.turn, 0.02);
    paintOutlined(picture, {{ellipse(collar, 10 - 2 * figure.turn, 3.6)}, White, LightGrey, 1},
                  Line);
}

} // namespace

Figure mirrored(const Figure& figure) {
    Figure other = figure;
    const auto flip = [](Point& point) { point.x = FigureSize - point.x; };
    other.head = mirrored(figure.head, FigureSize);
    flip(other.neck);
    flip(other.pelvis);
    for (Arm& arm : other.arms) {
        flip(arm.wrist);
        arm.angle = 180 - arm.angle;
        arm.bend = -arm.bend;
        arm.thumb = -arm.thumb;
    }
    for (Leg& leg : other.legs) {
        flip(leg.ankle);
        leg.toe = -leg.toe;
        leg.bend = -leg.bend;
    }
    return other;
}

Picture drawFigure(const Figure& figure) {
    Picture picture(FigureSize, FigureSize);
    for (std::size_t which = 0; which < 2; ++which) {
        if (figure.arms[which].behind) {
            paintArm(picture, figure, which);
        }
    }
    paintLeg(picture, figure, 0);
    paintLeg(picture, figure, 1);
    paintCoat(picture, figure);
    paintHead(picture, figure.head);
    for (std::size_t which = 0; which < 2; ++which) {
        if (!figure.arms[which].behind) {
            paintArm(picture, figure, which);
        }
    }
    fillSpecks(picture, 12, Line);
    return picture;
}

} // namespace art
