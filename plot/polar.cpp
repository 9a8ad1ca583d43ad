#include "plot/axis.h"
#include "plot/curve.h"

// The polar diagram: gamma 0 at the bottom, C to the right and C + 180 to the left. Of light that goes into one
// half of the room alone, that half is shown.

namespace OvPlot {

namespace {

constexpr double visibleShare = 0.005;  // of the peak: less is dark
constexpr double tolerance = 0.04;
constexpr double angleStep = 15;

struct Layout {
    Point centre;
    double radius;
    double first;  // gammas shown
    double last;
};

double largestOf(const std::vector<PlaneCurve>& curves, double first = 0, double last = 180) {
    double most = 0;
    for (const PlaneCurve& curve : curves) most = std::max(most, curve.largest(first, last));
    return most;
}

Layout layoutOf(const std::vector<PlaneCurve>& curves, const Box& room) {
    const double most = largestOf(curves);
    const bool below = largestOf(curves, 0, 90) > visibleShare * most;
    const bool above = largestOf(curves, 90.1, 180) > visibleShare * most;
    const double labels = 24;
    const double side = room.width() / 2 - 34;
    if (above == below) {
        const double radius = std::min(side, room.height() / 2 - labels);
        return {room.centre(), radius, 0, 180};
    }
    const double radius = std::min(side, room.height() - labels - 12);
    const double slack = (room.height() - labels - 12 - radius) / 2;
    if (below) return {{room.centre().x, room.top + 12 + slack}, radius, 0, 90};
    return {{room.centre().x, room.bottom - 12 - slack}, radius, 90, 180};
}

Point at(const Layout& layout, double angle, double radius) {
    return layout.centre + Point{radius * std::sin(radians(angle)), radius * std::cos(radians(angle))};
}

void drawRings(Canvas& canvas, const Layout& layout, const Axis& axis) {
    // Gamma counts from the bottom, Cairo's angles from the right, clockwise.
    const double from = radians(layout.first == 0 ? 90 - layout.last : 180);
    const double to = radians(layout.first == 0 ? 90 + layout.last : 360);
    for (const double tick : axis.ticks()) {
        if (tick > 0) canvas.arc(layout.centre, layout.radius * axis.share(tick), from, to, canvas.gridPen());
    }
}

void drawRays(Canvas& canvas, const Layout& layout) {
    const Font font = canvas.mutedFont(12);
    const auto drawRay = [&](double angle) {
        canvas.line(layout.centre, at(layout, angle, layout.radius), canvas.gridPen());
        canvas.text(at(layout, angle, layout.radius + 15), tickLabel(std::abs(angle)) + "\u00b0", font,
                    Align::centre);
    };
    for (double gamma = layout.first; gamma <= layout.last; gamma += angleStep) {
        drawRay(gamma);
        if (gamma > 0 && gamma < 180) drawRay(-gamma);
    }
}

double clearance(const std::vector<Path>& paths, Point place) {
    double nearest = 1e9;
    for (const Path& path : paths)
        for (const Point& point : path) nearest = std::min(nearest, distance(point, place));
    return nearest;
}

/// Angles between two rays, those nearest to the horizontal first.
std::vector<double> anglesBetweenRays(const Layout& layout) {
    std::vector<double> angles;
    for (double off = angleStep / 2; off < 90; off += angleStep) {
        for (const double angle : {90 - off, 90 + off})
            if (angle > layout.first && angle < layout.last) angles.insert(angles.end(), {angle, -angle});
    }
    return angles;
}

/// One of them at which labels of the rings lie far enough from the curves, or else the farthest.
double labelAngle(const Layout& layout, const Axis& axis, const std::vector<Path>& paths) {
    constexpr double enough = 15;
    double best = 0;
    double most = -1;
    for (const double angle : anglesBetweenRays(layout)) {
        double nearest = enough;
        for (const double tick : axis.ticks()) {
            const Point place = at(layout, angle, layout.radius * axis.share(tick)) - layout.centre;
            if (tick > 0) nearest = std::min(nearest, clearance(paths, place));
        }
        if (nearest <= most) continue;
        most = nearest;
        best = angle;
    }
    return best;
}

void drawCurves(Canvas& canvas, const Diagram& diagram, const Layout& layout, const std::vector<Path>& paths) {
    const std::size_t planes = diagram.planes.size();
    for (std::size_t i = 0; i < paths.size(); ++i) {
        Path path = simplified(paths[i], tolerance);
        for (Point& point : path) point = point + layout.centre;
        canvas.stroke(path, true, curvePen(canvas, diagram, i / planes, i % planes));
    }
}

std::vector<Path> pathsOf(const std::vector<PlaneCurve>& curves, double scale) {
    std::vector<Path> paths;
    for (const PlaneCurve& curve : curves) paths.push_back(polarPath(curve, scale));
    return paths;
}

}  // namespace

void drawPolar(Canvas& canvas, const Diagram& diagram) {
    const Box room = drawCaption(canvas, diagram, "Luminous intensity in cd", true);
    const std::vector<PlaneCurve> curves = planeCurves(diagram);
    const Axis axis = axisTo(largestOf(curves), 5);
    const Layout layout = layoutOf(curves, room);
    const std::vector<Path> paths = pathsOf(curves, layout.radius / axis.last);
    drawRings(canvas, layout, axis);
    drawRays(canvas, layout);
    drawCurves(canvas, diagram, layout, paths);
    const double angle = labelAngle(layout, axis, paths);
    for (const double tick : axis.ticks()) {
        if (tick > 0)
            canvas.label(at(layout, angle, layout.radius * axis.share(tick)), tickLabel(tick), canvas.font(12));
    }
}

void drawThumbnail(Canvas& canvas, const Subject& subject) {
    constexpr double coarse = 3;  // degrees
    const std::vector<PlaneCurve> curves{{subject, 0, coarse}, {subject, 90, coarse}};
    const double most = largestOf(curves);
    const Box room{20, 20, canvas.width() - 20, canvas.height() - 20};
    const double radius = std::min(room.width(), room.height()) / 2;
    const Layout layout{room.centre(), radius, 0, 180};
    canvas.circle(layout.centre, radius, {canvas.palette().grid, 8, 0});
    canvas.line(at(layout, 90, radius), at(layout, -90, radius), {canvas.palette().grid, 8, 0});
    const std::vector<Path> paths = pathsOf(curves, most > 0 ? radius / most : 0);
    for (std::size_t i = paths.size(); i-- > 0;) {
        Path path = simplified(paths[i], 4);
        for (Point& point : path) point = point + layout.centre;
        canvas.stroke(path, true, {canvas.palette().series[i], 14, 0});
    }
}

}  // namespace OvPlot
