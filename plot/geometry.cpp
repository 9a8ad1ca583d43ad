#include "plot/geometry.h"

namespace OvPlot {

namespace {

double distanceToSegment(Point p, Point a, Point b) {
    const Point d = b - a;
    const double square = d.x * d.x + d.y * d.y;
    const double t = square > 0 ? ((p.x - a.x) * d.x + (p.y - a.y) * d.y) / square : 0;
    return distance(p, a + std::clamp(t, 0.0, 1.0) * d);
}

}  // namespace

Path simplified(const Path& path, double tolerance) {
    if (path.size() < 3) return path;
    // Douglas and Peucker (1973): a stretch is cut at its farthest point until none is far from its chord.
    std::vector<bool> kept(path.size());
    kept.front() = kept.back() = true;
    std::vector<std::pair<std::size_t, std::size_t>> stretches{{0, path.size() - 1}};
    while (!stretches.empty()) {
        const auto [first, last] = stretches.back();
        stretches.pop_back();
        std::size_t farthest = first;
        double most = tolerance;
        for (std::size_t i = first + 1; i < last; ++i) {
            const double far = distanceToSegment(path[i], path[first], path[last]);
            if (far <= most) continue;
            most = far;
            farthest = i;
        }
        if (farthest == first) continue;
        kept[farthest] = true;
        stretches.insert(stretches.end(), {{first, farthest}, {farthest, last}});
    }
    Path result;
    for (std::size_t i = 0; i < path.size(); ++i)
        if (kept[i]) result.push_back(path[i]);
    return result;
}

}  // namespace OvPlot
