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
constexpr double ThighRadius = 7;

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

std::vector<Point> coatFront(double lift) {
    return {{0, -0.02},  {9, 0.02 - lift}, {14, 0.14 - lift},  {13.5, 0.5},
            {15, 0.95},  {13, 1.12},       {0, 1.16},          {-13, 1.12},
            {-15, 0.95}, {-13.5, 0.5},     {-14, 0.14 - lift}, {-9, 0.02 - lift}};
}

Point knee(const Figure& figure, std::size_t which) {
    const Leg& leg = figure.legs[which];
    const Point root = hip(figure, which);
    const double seen = distance(root, leg.ankle) * (1 + leg.slack) / (Thigh + Shin);
    const double scale = std::min(seen, 1.0);
    return joint(root, leg.ankle, Thigh * scale, Shin * scale, leg.bend);
}

// How far the coat's hem is from his middle on one side, so that it lies over the thighs.
double hemAside(const Figure& figure, double side) {
    const double down = figure.pelvis.y + 5;
    double aside = 10;
    for (std::size_t which = 0; which < 2; ++which) {
        const Point root = hip(figure, which);
        const Point bent = knee(figure, which);
        const double share = (down - root.y) / std::max(bent.y - root.y, 1.0);
        const Point middle = mix(root, bent, std::clamp(share, 0.0, 1.0));
        aside = std::max(aside, (middle.x - figure.pelvis.x) * side + ThighRadius + 1);
    }
    return std::min(aside, 15.0);
}

// Looking right: the chest is out, the small of the back is in.
std::vector<Point> coatSide(double front, double back) {
    return {{0, -0.04},
            {6, 0.0},
            {10.5, 0.16},
            {12.2, 0.45},
            {(12 + front) / 2, 0.9},
            {front, 1.14},
            {0, 1.17},
            {-back, 1.14},
            {-(10 + back) / 2, 0.9},
            {-9, 0.55},
            {-10.2, 0.2},
            {-6, 0.0}};
}

std::vector<Outline> coatOutlines(const Figure& figure) {
    const Trunk at = trunkOf(figure);
    const double side = facing(figure);
    const double back = std::min(hemAside(figure, -side), 11.0);
    const auto fromSide = coatSide(hemAside(figure, side), back);
    std::vector<Point> points;
    for (const Point& point : mix(coatFront(figure.shoulderLift / 40), fromSide, figure.turn)) {
        points.push_back(at(point.x * side, point.y));
    }
    return {blob(points)};
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

Point elbow(const Figure& figure, std::size_t which) {
    const Arm& arm = figure.arms[which];
    const Point root = shoulder(figure, which);
    const double seen = distance(root, arm.wrist) * (1 + arm.slack) / (UpperArm + LowerArm);
    const double scale = std::min(seen, 1.0);
    return arm.elbow.value_or(joint(root, arm.wrist, UpperArm * scale, LowerArm * scale, arm.bend));
}

// In the side view the first arm and leg are on the far side, away from the light.
bool isFar(const Figure& figure, std::size_t which) {
    return which == 0 && figure.turn > 0.5;
}

void paintArm(Picture& picture, const Figure& figure, std::size_t which) {
    const Arm& arm = figure.arms[which];
    const Point root = shoulder(figure, which);
    const Point bent = elbow(figure, which);
    const Ink cloth = isFar(figure, which) ? CoatShade : Coat;
    const Ink glow = isFar(figure, which) ? CoatShade : CoatGlow;
    const Point end = mix(arm.wrist, bent, 3 / std::max(distance(arm.wrist, bent), 3.0));
    const Part sleeve = {tube({root, bent, end}, 5.4 + 0.8 * figure.turn, 4.4), cloth, CoatShade, 2,
                         glow};
    const Mask mask = paintOutlined(picture, sleeve, Line);
    if (figure.turn < 0.5) {
        takeGlow(picture, figure, mask);
    }
    if (figure.turn < 0.5 && !arm.behind) {
        joinSleeve(picture, figure, root);
    }
    paintHand(picture, arm.grip, arm.wrist, arm.angle, arm.thumb);
    paintCuff(picture, bent, arm.wrist);
}

void paintShoe(Picture& picture, const Leg& leg, bool far) {
    const double side = leg.toe < 0 ? -1 : 1;
    const double length = std::fabs(leg.toe);
    Outline sole = {{-6.5, 1}, {-4.5, -3.5}, {1, -4.5}, {5, -2}, {10, -2.5},
                    {14.5, 0}, {15.5, 4},    {13, 6},   {3, 6},  {-5, 6}};
    for (Point& point : sole) {
        point = leg.ankle + turned({point.x * side * length, point.y}, leg.angle * side);
    }
    const Ink lit = far ? Ink(Red, DarkRed) : Leather;
    paintOutlined(picture, {{blob(sole)}, lit, LeatherShade, 2}, Line);
}

void paintLeg(Picture& picture, const Figure& figure, std::size_t which) {
    const Leg& leg = figure.legs[which];
    const bool far = isFar(figure, which);
    paintShoe(picture, leg, far);
    const Part trouser = {
        tube({hip(figure, which), knee(figure, which), leg.ankle - Point{0, 1}}, ThighRadius, 4.6),
        far ? TrousersShade : Trousers, TrousersShade, 2, far ? TrousersShade : TrousersGlow};
    paintOutlined(picture, trouser, Line);
}

// Whether a sleeve before the coat hides a place on it.
bool underSleeve(const Figure& figure, Point place) {
    constexpr double SleeveRadius = 7.2;
    for (std::size_t which = 0; which < 2; ++which) {
        const Point bent = elbow(figure, which);
        for (int i = 0; i <= 10 && !figure.arms[which].behind; ++i) {
            const double share = i / 10.0;
            if (distance(mix(shoulder(figure, which), bent, share), place) < SleeveRadius ||
                distance(mix(bent, figure.arms[which].wrist, share), place) < SleeveRadius) {
                return true;
            }
        }
    }
    return false;
}

void paintButtons(Picture& picture, const Figure& figure, double aside, const Mask& coat) {
    std::vector<Outline> buttons;
    for (const double down : {0.32, 0.56, 0.8}) {
        const Point exact = trunkOf(figure)(aside, down);
        // On the corner of four pixels it is round in every picture.
        const Point place = {std::round(exact.x), std::round(exact.y)};
        // Half a button that looks out from under a sleeve would be dirt.
        if (figure.turn < 0.5 || !underSleeve(figure, place)) {
            buttons.push_back(ellipse(place, 2, 2));
        }
    }
    // A single one would be a spot, not a row of buttons.
    if (buttons.size() > 1) {
        paintWithin(picture, {std::move(buttons), Brass, BrassShade, 1}, coat);
    }
}

void paintCoat(Picture& picture, const Figure& figure) {
    const Trunk at = trunkOf(figure);
    const Mask coat =
        paintOutlined(picture, {coatOutlines(figure), Coat, CoatShade, 3, CoatGlow}, Line);
    const double seam = 8 * figure.turn * facing(figure);
    // The buttons are on his left side, so the walk to the left shows them best.
    const double buttons = seam + 3.2 - 1.9 * figure.turn;
    paintWithin(picture, {{bone(at(seam, 0), at(seam, 1.3), 0.55, 0.55)}, CoatShade, CoatShade, 0},
                coat);
    paintButtons(picture, figure, buttons, coat);
    // From the side the nape hides its other end.
    const Point collar = at(4 * figure.turn * facing(figure), 0.02);
    paintOutlined(picture, {{ellipse(collar, 10 - 4 * figure.turn, 3.6)}, Linen, LinenShade, 1},
                  Line);
}

} // namespace

Point shoulder(const Figure& figure, std::size_t which) {
    double aside = (which == 0 ? -12 : 12) * (1 - figure.turn * figure.turn);
    if (figure.turn > 0.5) {
        // The chest is turned to us a little, so the far shoulder shows in front.
        aside = (which == 0 ? 3 - figure.twist : -4 + figure.twist) * facing(figure);
    }
    return trunkOf(figure)(aside, figure.turn > 0.5 ? 0.19 : 0.16) - Point{0, figure.shoulderLift};
}

Point hip(const Figure& figure, std::size_t which) {
    const double aside = (6.5 - 5.5 * figure.turn) * facingOfLimbs(figure);
    return figure.pelvis + Point{which == 0 ? -aside : aside, -4 + 4 * figure.turn};
}

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
    // Half turned, the leg behind is the one on the side that he looks to.
    const bool halfTurned = figure.turn > 0 && figure.turn < 0.5;
    const std::size_t back = halfTurned && facing(figure) > 0 ? 1 : 0;
    paintLeg(picture, figure, back);
    paintLeg(picture, figure, 1 - back);
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
