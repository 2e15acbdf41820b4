#include "resources/art/head.h"

#include "resources/art/features.h"
#include "resources/art/wardrobe.h"

#include <algorithm>
#include <cmath>
#include <utility>
#include <vector>

namespace art {

namespace {

// The measures below are for a face of this length from eyes to mouth.
constexpr double PlainLength = 17;

// Places on the head: counted from the middle between the eyes, for a head that looks right or at
// us, then carried to the picture.
struct Place {
    Point eyes;
    double side;
    double turn;
    double stretch;

    explicit Place(const Head& head)
        : eyes(head.eyeCell + Point{CellSize / 2.0, CellSize / 2.0}), side(head.turn < 0 ? -1 : 1),
          turn(std::fabs(head.turn)), stretch((head.mouthCell.y - head.eyeCell.y) / PlainLength) {}

    Point operator()(double x, double y) const {
        // Between eyes and mouth his face is as long as the pose has it; the chin never changes.
        const double below = std::max(y - PlainLength, 0.0);
        return {eyes.x + side * x, eyes.y + (y > 0 ? (y - below) * stretch + below : y)};
    }

    std::vector<Point> operator()(std::vector<Point> points) const {
        for (Point& point : points) {
            point = (*this)(point.x, point.y);
        }
        return points;
    }
};

Part skinPart(std::vector<Outline> outlines, int shadow) {
    return {std::move(outlines), Skin, SkinShade, shadow};
}

std::vector<Point> faceFront() {
    return {{0, -14}, {8, -12},     {12.5, -5},  {12, 4},     {13.5, 12}, {12.5, 20},  {7.5, 25.5},
            {0, 27},  {-7.5, 25.5}, {-12.5, 20}, {-13.5, 12}, {-12, 4},   {-12.5, -5}, {-8, -12}};
}

std::vector<Point> faceHalf() {
    return {{-3, -14}, {5, -12}, {9.5, -6}, {8.5, 3},  {12.5, 12}, {14, 19},  {11, 25},
            {4.5, 27}, {-4, 26}, {-11, 21}, {-13, 13}, {-14, 4},   {-16, -5}, {-11, -12}};
}

void paintEar(Picture& picture, const Place& at, double x) {
    const Part ear = skinPart({ellipse(at(x, 4), 2.8, 4.2)}, 1);
    const Mask inside = paintOutlined(picture, ear, Line);
    paintWithin(picture, {{ellipse(at(x, 4.4), 1.3, 2.3)}, Blush, Blush, 0}, inside);
}

// Hair sticks out below the cap, on the sides that can be seen.
void paintHair(Picture& picture, const Place& at) {
    const double back = -11.5 - 2 * at.turn;
    std::vector<Outline> tufts = {ellipse(at(back - 2, -2), 4, 4.5),
                                  ellipse(at(back - 1.5, 4), 4, 4),
                                  ellipse(at(back - 0.5, 9.5), 3.4, 4)};
    if (at.turn < 0.5) {
        tufts.push_back(ellipse(at(14.5, -2), 4, 4.5));
        tufts.push_back(ellipse(at(14, 4), 4, 4));
        tufts.push_back(ellipse(at(12.8, 9.5), 3.4, 4));
    }
    paintOutlined(picture, {std::move(tufts), Hair, HairShade, 1}, Line);
}

void paintFace(Picture& picture, const Place& at) {
    if (at.turn < 0.5) {
        paintEar(picture, at, 13 - 4 * at.turn);
        paintEar(picture, at, -13);
    }
    const auto points = mix(faceFront(), faceHalf(), at.turn);
    const Mask face = paintOutlined(picture, skinPart({blob(at(points))}, 2), Line);
    const Part cheeks = {{ellipse(at(8.5 + 1.5 * at.turn, 13), 2.6, 2.2),
                          ellipse(at(-8.5 + 1.5 * at.turn, 13), 2.6, 2.2)},
                         Blush,
                         Blush,
                         0};
    paintWithin(picture, cheeks, face);
    if (at.turn >= 0.5) {
        paintEar(picture, at, -13.5 + 3 * at.turn);
    }
}

void paintNose(Picture& picture, const Place& at) {
    const Point tip = at(7.5 * at.turn, 7.6);
    const Point root = at(2.0 * at.turn, 1);
    Part nose = skinPart({bone(root, tip, 2.2, 4), ellipse(tip, 6.6, 4.9, 8 * at.side)}, 2);
    nose.shade = Blush;
    const Mask mask = paintOutlined(picture, nose, Line);
    const Part shine = {{ellipse(tip + Point{-2.2, -2}, 1.8, 1.3)}, White, White, 0};
    paintWithin(picture, shine, mask);
}

void paintCap(Picture& picture, const Place& at, double swing) {
    const double back = -3 * at.turn;
    const Point root = at(back - 5, -13);
    const auto hang = [&](double x, double y) {
        const Point swung = turned({x, y}, swing);
        return root + Point{at.side * swung.x, swung.y};
    };
    const Point tip = hang(-16, 15);
    std::vector<Outline> felt =
        tube({at(back + 2, -12.5), root, hang(-9, 2), hang(-14, 8), tip}, 4.2, 2);
    felt.push_back(blob(at({{back - 12, -9},
                            {back - 9, -14},
                            {back, -16.8},
                            {back + 9, -14},
                            {back + 11.5, -9},
                            {back, -8}})));
    paintOutlined(picture, {std::move(felt), Felt, FeltShade, 2, FeltGlow}, Line);
    paintOutlined(picture, {{ellipse(tip + Point{0, 3}, 3.6, 3.6)}, Bobble, BobbleShade, 1}, Line);
    const Part band = {{bone(at(back - 11.5, -8.6), at(back + 11.5 + at.turn, -9.4), 2.4, 2.4)},
                       Trim,
                       TrimShade,
                       1};
    paintOutlined(picture, band, Line);
}

} // namespace

Head mirrored(const Head& head, int pictureWidth) {
    Head other = head;
    other.eyeCell.x = pictureWidth - CellSize - head.eyeCell.x;
    other.mouthCell.x = pictureWidth - CellSize - head.mouthCell.x;
    other.turn = -head.turn;
    return other;
}

Point chin(const Head& head) {
    const Place at(head);
    return at(4.5 * at.turn - 3 * at.turn, 27);
}

void paintHead(Picture& picture, const Head& head) {
    const Place at(head);
    paintHair(picture, at);
    paintFace(picture, at);
    paintCap(picture, at, head.capSwing);
    paintNose(picture, at);
    paintFeatures(picture, head);
}

} // namespace art
