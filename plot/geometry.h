#pragma once

#include <algorithm>
#include <cmath>
#include <vector>

// The plane that pictures are drawn on: x to the right, y downwards.

namespace OvPlot {

struct Point {
    double x = 0;
    double y = 0;

    friend Point operator+(Point a, Point b) { return {a.x + b.x, a.y + b.y}; }
    friend Point operator-(Point a, Point b) { return {a.x - b.x, a.y - b.y}; }
    friend Point operator*(double factor, Point p) { return {factor * p.x, factor * p.y}; }
};

inline double distance(Point a, Point b) { return std::hypot(a.x - b.x, a.y - b.y); }

struct Box {
    double left = 0;
    double top = 0;
    double right = 0;
    double bottom = 0;

    double width() const { return right - left; }
    double height() const { return bottom - top; }
    Point centre() const { return {(left + right) / 2, (top + bottom) / 2}; }
    bool overlaps(const Box& other) const {
        return left < other.right && other.left < right && top < other.bottom && other.top < bottom;
    }
    bool contains(const Box& other) const {
        return left <= other.left && other.right <= right && top <= other.top && other.bottom <= bottom;
    }
    Box grownBy(double margin) const { return {left - margin, top - margin, right + margin, bottom + margin}; }
};

using Path = std::vector<Point>;

/// The path without points that lie nearer than `tolerance` to it when they are left out. The first and the last
/// stay.
Path simplified(const Path& path, double tolerance);

}  // namespace OvPlot
