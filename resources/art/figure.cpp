#include "resources/art/figure.h"

#include "resources/art/painter.h"
#include "resources/art/wardrobe.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace art {

namespace {

// See-through spots up to this many pixels would look like dirt in the figure.
constexpr std::size_t LargestSpeck = 12;

constexpr double UpperArm = 19;
constexpr double LowerArm = 18;
constexpr double Thigh = 24.5;
constexpr double Shin = 23.5;

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

// 1 where he is turned to the right, -1 to the left.
double facing(const Figure& figure) {
    return figure.head.turn < 0 ? -1 : 1;
}

// The same for the order of his limbs: seen from the front the first is on the left either way.
double facingOfLimbs(const Figure& figure) {
    return figure.turn < 0.5 ? 1 : facing(figure);
}

Point shoulder(const Figure& figure, std::size_t which) {
    const double aside = (12 - 9.5 * figure.turn) * facingOfLimbs(figure);
    return trunkOf(figure)(which == 0 ? -aside : aside, 0.16) - Point{0, figure.shoulderLift};
}

Point hip(const Figure& figure, std::size_t which) {
    const double aside = (6.5 - 5.5 * figure.turn) * facingOfLimbs(figure);
    return figure.pelvis + Point{which == 0 ? -aside : aside, -4};
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
        const double side = facing(figure);
        const std::vector<Point> hang = {at(-7 * side, 0.7),
                                         at((-10 - figure.tails * 0.3) * side, 1.0),
                                         at((-9 - figure.tails) * side, 1.3)};
        for (Outline& outline : tube(hang, 8, 4)) {
            outlines.push_back(std::move(outline));
        }
    }
    return outlines;
}

// Takes away the line between sleeve and coat at the shoulder, where they are one piece of cloth.
void joinSleeve(Picture& picture, const Figure& figure, Point root) {
    const Mask coat = coverage(coatOutlines(figure), picture.width, picture.height);
    paintWithin(picture, {{ellipse(root + Point{0, 1.5}, 5, 5.5)}, Coat, Coat, 0}, coat);
}

// No light falls on a sleeve's rim where the body is behind it.
void takeGlow(Picture& picture, const Figure& figure, const Mask& sleeve) {
    const Mask coat = coverage(coatOutlines(figure), picture.width, picture.height);
    for (std::size_t i = 0; i < picture.pixels.size(); ++i) {
        if (sleeve.pixels[i] != 0 && coat.pixels[i] != 0 && picture.pixels[i] == Magenta) {
            picture.pixels[i] = DarkMagenta;
        }
    }
}

void paintCuff(Picture& picture, Point elbow, Point wrist) {
    const Point along = (wrist - elbow) * (1 / std::max(distance(elbow, wrist), 0.001));
    const Point across = {-along.y, along.x};
    const Part cuff = {
        {bone(wrist - across * 3.6, wrist + across * 3.6, 1.9, 1.9)}, Trim, TrimShade, 1};
    paintOutlined(picture, cuff, Line);
}

void paintArm(Picture& picture, const Figure& figure, std::size_t which) {
    const Arm& arm = figure.arms[which];
    const Point root = shoulder(figure, which);
    const double seen = distance(root, arm.wrist) * (1 + arm.slack) / (UpperArm + LowerArm);
    const double scale = std::min(seen, 1.0);
    const Point elbow =
        arm.elbow.value_or(joint(root, arm.wrist, UpperArm * scale, LowerArm * scale, arm.bend));
    const Point end = mix(arm.wrist, elbow, 3 / std::max(distance(arm.wrist, elbow), 3.0));
    const Part sleeve = {tube({root, elbow, end}, 5.4, 4.4), Coat, CoatShade, 2, CoatGlow};
    const Mask cloth = paintOutlined(picture, sleeve, Line);
    takeGlow(picture, figure, cloth);
    if (figure.turn < 0.5 && !arm.behind) {
        joinSleeve(picture, figure, root);
    }
    paintHand(picture, arm.grip, arm.wrist, arm.angle, arm.thumb);
    paintCuff(picture, elbow, arm.wrist);
}

void paintShoe(Picture& picture, const Leg& leg) {
    const double side = leg.toe < 0 ? -1 : 1;
    const double length = std::fabs(leg.toe);
    Outline sole = {{-6.5, 1}, {-4.5, -3.5}, {1, -4.5}, {5, -2}, {10, -2.5},
                    {14.5, 0}, {15.5, 4},    {13, 6},   {3, 6},  {-5, 6}};
    for (Point& point : sole) {
        point = leg.ankle + turned({point.x * side * length, point.y}, leg.angle * side);
    }
    paintOutlined(picture, {{blob(sole)}, Leather, LeatherShade, 2}, Line);
}

void paintLeg(Picture& picture, const Figure& figure, std::size_t which) {
    const Leg& leg = figure.legs[which];
    const Point root = hip(figure, which);
    const double seen = distance(root, leg.ankle) * (1 + leg.slack) / (Thigh + Shin);
    const double scale = std::min(seen, 1.0);
    const Point knee = joint(root, leg.ankle, Thigh * scale, Shin * scale, leg.bend);
    paintShoe(picture, leg);
    const bool far = which == 0 && figure.turn > 0.5;
    const Part trouser = {tube({root, knee, leg.ankle - Point{0, 1}}, 7, 4.6),
                          far ? TrousersShade : Trousers, TrousersShade, 2,
                          far ? TrousersShade : TrousersGlow};
    paintOutlined(picture, trouser, Line);
}

void paintCoat(Picture& picture, const Figure& figure) {
    const Trunk at = trunkOf(figure);
    const Mask coat =
        paintOutlined(picture, {coatOutlines(figure), Coat, CoatShade, 3, CoatGlow}, Line);
    const double seam = 8 * figure.turn * facing(figure);
    const double buttons = seam + 3.2 * facingOfLimbs(figure);
    paintWithin(picture, {{bone(at(seam, 0), at(seam, 1.3), 0.55, 0.55)}, CoatShade, CoatShade, 0},
                coat);
    for (const double down : {0.32, 0.56, 0.8}) {
        paintWithin(picture, {{ellipse(at(buttons, down), 1.7, 1.7)}, Brass, BrassShade, 1}, coat);
    }
    const Point collar = at(1.5 * figure.turn * facing(figure), 0.02);
    paintOutlined(picture, {{ellipse(collar, 10 - 2 * figure.turn, 3.6)}, Linen, LinenShade, 1},
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
        if (arm.elbow) {
            flip(*arm.elbow);
        }
        arm.angle = 180 - arm.angle;
        arm.bend = -arm.bend;
        arm.thumb = -arm.thumb;
    }
    for (Leg& leg : other.legs) {
        flip(leg.ankle);
        leg.toe = -leg.toe;
        leg.bend = -leg.bend;
    }
    if (figure.turn < 0.5) {
        // What was on the left is now on the right. From the side the far ones stay the far ones.
        std::swap(other.arms[0], other.arms[1]);
        std::swap(other.legs[0], other.legs[1]);
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
    fillSpecks(picture, LargestSpeck, Line);
    return picture;
}

} // namespace art
