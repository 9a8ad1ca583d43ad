#include "tools/numbers/numbers.h"
#include "plot/axis.h"
#include "plot/curve.h"
#include "plot/illuminance.h"

// The cone diagram: how wide the beam is at a distance, between the directions in which the intensity is down to
// half of its peak, and how much light arrives there.

namespace OvPlot {

namespace {

constexpr double widest = 85;  // degrees from the axis: beams beyond do not meet a plane

std::optional<AngleSpan> beamOf(const Subject& subject, std::size_t plane) {
    if (plane >= subject.beams.size() || !subject.beams[plane]) return {};
    const AngleSpan span = *subject.beams[plane];
    return std::max(std::abs(span.first), std::abs(span.last)) < widest ? std::optional(span) : std::nullopt;
}

double offset(double angle) { return std::tan(radians(angle)); }

std::string diameterText(const std::optional<AngleSpan>& beam, double distance) {
    return beam ? OvTool::fixedNumber(distance * (offset(beam->last) - offset(beam->first)), 2) : "\u2013";
}

std::string luxText(double lux) { return OvTool::fixedNumber(lux, lux < 10 ? 2 : lux < 100 ? 1 : 0); }

struct Column {
    std::string heading;
    std::string unit;
    std::function<std::string(double)> value;
};

void drawTable(Canvas& canvas, const Box& room, const std::vector<double>& places, const std::vector<double>& ys,
               const std::vector<Column>& columns) {
    const double width = room.width() / static_cast<double>(columns.size());
    for (std::size_t i = 0; i < columns.size(); ++i) {
        const double right = room.left + width * static_cast<double>(i + 1) - 6;
        canvas.text({right, room.top + 8}, columns[i].heading, canvas.mutedFont(12), Align::right);
        canvas.text({right, room.top + 25}, columns[i].unit, canvas.mutedFont(12), Align::right);
        for (std::size_t k = 0; k < places.size(); ++k)
            canvas.text({right, ys[k]}, columns[i].value(places[k]), canvas.font(), Align::right);
    }
}

/// The beam of a plane from the luminaire at `apex` to the last distance at `bottom`.
Path beamPath(Point apex, double bottom, const AngleSpan& beam, double scale) {
    return {apex, {apex.x + scale * offset(beam.first), bottom}, {apex.x + scale * offset(beam.last), bottom}};
}

void drawCones(Canvas& canvas, const Subject& subject, const Box& box) {
    double extent = 0;
    for (std::size_t plane = 0; plane < 2; ++plane)
        if (const auto beam = beamOf(subject, plane))
            extent = std::max({extent, std::abs(offset(beam->first)), std::abs(offset(beam->last))});
    // Wide beams are drawn narrower than they are.
    const double scale = std::min(box.height(), extent > 0 ? box.width() / 2 / extent : 0);
    const Point apex{box.centre().x, box.top};
    const Palette& palette = canvas.palette();
    if (const auto beam = beamOf(subject, 0)) {
        const Path path = beamPath(apex, box.bottom, *beam, scale);
        canvas.fill(path, mixed(palette.paper, palette.series[0], 0.15));
        canvas.stroke(path, true, {palette.series[0], 1.8, 0});
    }
    if (const auto beam = beamOf(subject, 1))
        canvas.stroke(beamPath(apex, box.bottom, *beam, scale), true, {palette.series[1], 1.8, 1});
    if (extent == 0) canvas.label(box.centre() - Point{0, 20}, "no beam within 85\u00b0", canvas.mutedFont());
    canvas.disc(apex, 4, palette.ink);
}

}  // namespace

void drawCone(Canvas& canvas, const Diagram& diagram) {
    // The two main planes, and round distances without 0.
    Diagram main = diagram;
    main.planes = {0, 90};
    const Subject& subject = main.subjects.front();
    const Box room = drawCaption(canvas, main, "Beam width and illuminance over the distance", true);
    std::vector<double> distances = axisTo(diagram.height.value_or(5), 5).ticks();
    distances.erase(distances.begin());

    // On the left the cones, with a line across the page for each distance.
    const double tableLeft = room.left + room.width() * 0.36;
    const Box box{room.left + 10, room.top + 44, tableLeft - 14, room.bottom - 14};
    std::vector<double> ys;
    for (const double distance : distances) {
        ys.push_back(box.top + box.height() * distance / distances.back());
        canvas.line({box.left, ys.back()}, {tableLeft, ys.back()}, canvas.gridPen());
    }
    drawCones(canvas, subject, box);

    // On the right the table.
    const double axial = subject.intensity(0, 0);
    const double largest = largestIlluminance(subject);
    const auto width = [&](std::size_t plane) {
        return [beam = beamOf(subject, plane)](double distance) { return diameterText(beam, distance); };
    };
    const auto illuminance = [](double candela) {
        return [candela](double distance) { return luxText(candela / (distance * distance)); };
    };
    drawTable(canvas, {tableLeft, room.top, room.right, room.bottom}, distances, ys,
              {{"Distance", "m", tickLabel},
               {planeName(subject, 0), "width, m", width(0)},
               {planeName(subject, 90), "width, m", width(1)},
               {"On axis", "lx", illuminance(axial)},
               {"Largest", "lx", illuminance(largest)}});
}

}  // namespace OvPlot
