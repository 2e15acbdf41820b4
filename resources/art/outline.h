#pragma once

#include <vector>

namespace art {

// A place in a picture, in pixels with fractions; y grows downwards.
struct Point {
    double x = 0;
    double y = 0;
};

Point operator+(Point a, Point b);
Point operator-(Point a, Point b);
Point operator*(Point a, double factor);
Point mix(Point a, Point b, double share);
// Turned about the origin; with y downwards a positive angle in degrees turns clockwise.
Point turned(Point point, double degrees);
double distance(Point a, Point b);

// A closed outline of straight pieces.
using Outline = std::vector<Point>;

Outline ellipse(Point centre, double radiusX, double radiusY, double degrees = 0);
// A bone with flesh: round at both ends, with a radius for each end.
Outline bone(Point from, Point to, double fromRadius, double toRadius);
// A smooth closed curve through the points.
Outline blob(const std::vector<Point>& through);
// A soft limb along a smooth curve through the points, with radii from the first to the last.
std::vector<Outline> tube(const std::vector<Point>& through, double fromRadius, double toRadius);
// Mixes two outlines of the same number of points.
std::vector<Point> mix(const std::vector<Point>& a, const std::vector<Point>& b, double share);

// Where a limb of two bones bends so that it reaches from root to end. Bend is 1 or -1 for the
// side. A limb that is too short is drawn straight and stretched.
Point joint(Point root, Point end, double upper, double lower, int bend);

} // namespace art
