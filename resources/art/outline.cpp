#include "resources/art/outline.h"

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <numbers>

namespace art {

namespace {

constexpr int CurveSteps = 32;

double radians(double degrees) {
    return degrees * std::numbers::pi / 180;
}

// A point of a smooth curve that runs through b and c, a and d being their neighbours.
Point between(Point a, Point b, Point c, Point d, double t) {
    const Point linear = (c - a) * 0.5;
    const Point square = a - b * 2.5 + c * 2 - d * 0.5;
    const Point cube = (b - c) * 1.5 + (d - a) * 0.5;
    return b + (linear + (square + cube * t) * t) * t;
}

} // namespace

Point operator+(Point a, Point b) {
    return {a.x + b.x, a.y + b.y};
}

Point operator-(Point a, Point b) {
    return {a.x - b.x, a.y - b.y};
}

Point operator*(Point a, double factor) {
    return {a.x * factor, a.y * factor};
}

Point mix(Point a, Point b, double share) {
    return a + (b - a) * share;
}

Point turned(Point point, double degrees) {
    const double c = std::cos(radians(degrees));
    const double s = std::sin(radians(degrees));
    return {point.x * c - point.y * s, point.x * s + point.y * c};
}

double distance(Point a, Point b) {
    return std::hypot(a.x - b.x, a.y - b.y);
}

Outline ellipse(Point centre, double radiusX, double radiusY, double degrees) {
    Outline outline;
    for (int i = 0; i < 2 * CurveSteps; ++i) {
        const double angle = std::numbers::pi * i / CurveSteps;
        const Point rim = {radiusX * std::cos(angle), radiusY * std::sin(angle)};
        outline.push_back(centre + turned(rim, degrees));
    }
    return outline;
}

Outline bone(Point from, Point to, double fromRadius, double toRadius) {
    const double angle = std::atan2(to.y - from.y, to.x - from.x);
    Outline outline;
    for (int i = 0; i <= 2 * CurveSteps + 1; ++i) {
        const bool far = i <= CurveSteps;
        const int step = far ? i : i - 1;
        const double rim = angle - std::numbers::pi / 2 + std::numbers::pi * step / CurveSteps;
        const double radius = far ? toRadius : fromRadius;
        outline.push_back((far ? to : from) + Point{std::cos(rim), std::sin(rim)} * radius);
    }
    return outline;
}

Outline blob(const std::vector<Point>& through) {
    const std::size_t count = through.size();
    Outline outline;
    for (std::size_t i = 0; i < count; ++i) {
        for (int step = 0; step < CurveSteps; ++step) {
            outline.push_back(between(through[(i + count - 1) % count], through[i],
                                      through[(i + 1) % count], through[(i + 2) % count],
                                      static_cast<double>(step) / CurveSteps));
        }
    }
    return outline;
}

std::vector<Outline> tube(const std::vector<Point>& through, double fromRadius, double toRadius) {
    constexpr int Pieces = 8;
    const std::size_t last = through.size() - 1;
    std::vector<Outline> outlines;
    Point from = through.front();
    double radius = fromRadius;
    for (std::size_t i = 0; i < last; ++i) {
        for (int step = 1; step <= Pieces; ++step) {
            const double t = static_cast<double>(step) / Pieces;
            const Point to = between(through[i == 0 ? 0 : i - 1], through[i], through[i + 1],
                                     through[std::min(i + 2, last)], t);
            const double share = (static_cast<double>(i) + t) / static_cast<double>(last);
            const double next = fromRadius + (toRadius - fromRadius) * share;
            outlines.push_back(bone(from, to, radius, next));
            from = to;
            radius = next;
        }
    }
    return outlines;
}

std::vector<Point> mix(const std::vector<Point>& a, const std::vector<Point>& b, double share) {
    std::vector<Point> mixed;
    for (std::size_t i = 0; i < a.size(); ++i) {
        mixed.push_back(mix(a[i], b[i], share));
    }
    return mixed;
}

Point joint(Point root, Point end, double upper, double lower, int bend) {
    const double reach = std::max(distance(root, end), 0.001);
    const double along =
        std::clamp((upper * upper - lower * lower + reach * reach) / (2 * reach), 0.0, reach);
    const double aside = std::sqrt(std::max(upper * upper - along * along, 0.0));
    const Point line = (end - root) * (1 / reach);
    const double side = reach < upper + lower ? aside * bend : 0;
    return root + line * along + Point{-line.y, line.x} * side;
}

} // namespace art
