#include <optional>

#include "plot/axis.h"
#include "plot/chart.h"
#include "plot/curve.h"
#include "plot/illuminance.h"
#include "plot/isolines.h"

namespace OvPlot {

namespace {

constexpr int levelCount = 7;
constexpr std::size_t gridSize = 161;
constexpr double farthest = 4;  // heights from the middle that are shown at the most

/// How far from the middle, in heights, a level is reached.
double reachOf(const Subject& subject, double height, double level) {
    double reach = 0.5;
    for (double c = 0; c < 360; c += 5) {
        for (double gamma = 80; gamma > 0; gamma -= 0.5) {
            const double distance = std::tan(radians(gamma));
            if (distance <= reach) break;
            if (horizontalIlluminance(subject, gamma, c, height) < level) continue;
            reach = distance;
            break;
        }
    }
    return std::min(1.05 * reach, farthest);
}

Grid sampledPlane(const Subject& subject, double height, double half) {
    Grid grid{gridSize, gridSize, {}};
    for (std::size_t row = 0; row < gridSize; ++row) {
        for (std::size_t column = 0; column < gridSize; ++column) {
            const auto place = [&](std::size_t i) {
                return (2.0 * static_cast<double>(i) / (gridSize - 1) - 1) * half;
            };
            const double x = place(column);
            const double y = -place(row);
            const double gamma = degrees(std::atan2(std::hypot(x, y), height));
            grid.values.push_back(
                horizontalIlluminance(subject, gamma, degrees(std::atan2(y, x)), height));
        }
    }
    return grid;
}

/// A place for a label on one of the lines, nearest to the upper right.
std::optional<Point> labelPlace(const Canvas& canvas, const std::vector<Path>& lines, const std::string& text,
                                LabelPlacer& placer) {
    std::vector<Point> places;
    for (const Path& line : lines) places.insert(places.end(), line.begin(), line.end());
    std::sort(places.begin(), places.end(), [](Point a, Point b) { return a.x - a.y > b.x - b.y; });
    for (const Point& place : places)
        if (placer.take(canvas.textBox(place, text, canvas.font(12), Align::centre).grownBy(3))) return place;
    return {};
}

void drawLines(Canvas& canvas, const Chart& chart, const Grid& grid, const std::vector<double>& levels) {
    const Palette& palette = canvas.palette();
    LabelPlacer placer(chart.box);
    std::vector<std::pair<Point, std::string>> labels;
    for (std::size_t i = 0; i < levels.size(); ++i) {
        const double fading = 0.55 * static_cast<double>(i) / levelCount;
        std::vector<Path> lines = isolines(grid, levels[i]);
        for (Path& line : lines) {
            for (Point& point : line)
                point = {chart.box.left + point.x / (gridSize - 1) * chart.box.width(),
                         chart.box.top + point.y / (gridSize - 1) * chart.box.height()};
            line = simplified(line, 0.04);
            canvas.stroke(line, false, {mixed(palette.series[0], palette.paper, fading), 1.8, 0});
        }
        const std::string text = tickLabel(levels[i]);
        if (const auto place = labelPlace(canvas, lines, text, placer)) labels.emplace_back(*place, text);
    }
    for (const auto& [place, text] : labels) canvas.label(place, text, canvas.font(12));
}

void drawLuminaire(Canvas& canvas, Point place) {
    const Pen pen{canvas.palette().series[1], 2, 0};
    canvas.line(place - Point{6, 0}, place + Point{6, 0}, pen);
    canvas.line(place - Point{0, 6}, place + Point{0, 6}, pen);
}

}  // namespace

void drawIsolux(Canvas& canvas, const Diagram& diagram) {
    const Subject& subject = diagram.subjects.front();
    const double height = diagram.height.value_or(3);
    const Box room = drawCaption(
        canvas, diagram,
        std::string("Illuminance in lx on a plane ") + tickLabel(height) + " m below (+), seen from above", false);

    // Levels by the brightest spot; the plane reaches as far as the lowest of them.
    const double most = largestIlluminance(subject) / (height * height);
    const std::vector<double> levels = roundLevels(most, levelCount);
    const double reach = height * (levels.empty() ? 1 : reachOf(subject, height, levels.back()));
    const Axis half = axisTo(reach, 5);

    // A square chart in the middle of the room.
    const double side = std::min(room.width() - 60, room.height() - 44);
    const double left = room.centre().x - side / 2 + 12;
    const Axis both{-half.last, half.last, half.step};
    const Chart chart{{left, room.top + 4, left + side, room.top + 4 + side}, both, both};
    drawGrid(canvas, chart);
    const bool aimed = subject.frame.aimed;
    canvas.text({chart.box.centre().x, chart.box.bottom + 34}, aimed ? "horizontally, m" : "m towards C0 \u2192",
                canvas.mutedFont(), Align::centre);
    canvas.textUpwards({chart.box.left - 46, chart.box.centre().y},
                       aimed ? "vertically, m" : "m towards C90 \u2192", canvas.mutedFont());

    // Lines of equal illuminance, and the luminaire above them.
    canvas.clipped(chart.box, [&] { drawLines(canvas, chart, sampledPlane(subject, height, half.last), levels); });
    drawLuminaire(canvas, chart.box.centre());
    if (levels.empty())
        canvas.label(chart.box.centre() - Point{0, 40}, "no light falls on the plane", canvas.font());
}

}  // namespace OvPlot
