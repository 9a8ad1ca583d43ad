#include "plot/axis.h"
#include "plot/chart.h"
#include "plot/curve.h"

namespace OvPlot {

namespace {

constexpr double visibleShare = 0.005;  // of the peak: less is dark

}  // namespace

void drawCartesian(Canvas& canvas, const Diagram& diagram) {
    const Box room = drawCaption(canvas, diagram, "Luminous intensity in cd over gamma", true);

    // The axes: as far as the brightest curve, and behind 90 degrees where there is light.
    const std::vector<PlaneCurve> curves = planeCurves(diagram);
    double most = 0;
    double behind = 0;
    for (const PlaneCurve& curve : curves) {
        most = std::max(most, curve.largest());
        behind = std::max(behind, curve.largest(90.1, 180));
    }
    const double last = behind > visibleShare * most ? 180 : 90;
    const Chart chart{{room.left + 46, room.top + 6, room.right - 14, room.bottom - 44},
                      degreeAxis(-last, last, 12),
                      axisTo(most, 6)};

    // Grid and captions.
    drawGrid(canvas, chart);
    const Subject& first = diagram.subjects.front();
    canvas.text({chart.box.centre().x, chart.box.bottom + 36},
                first.frame.aimed ? "Angle from the axis in degrees"
                                  : "\u2190 C + 180\u00b0      gamma in degrees      C \u2192",
                canvas.mutedFont(), Align::centre);

    // The curves.
    for (std::size_t i = 0; i < curves.size(); ++i) {
        Path path;
        for (std::size_t k = 0; k < curves[i].size(); ++k) {
            if (std::abs(curves[i].angle(k)) <= last)
                path.push_back(chart.at(curves[i].angle(k), curves[i].value(k)));
        }
        const std::size_t planes = diagram.planes.size();
        canvas.stroke(simplified(path, 0.04), false, curvePen(canvas, diagram, i / planes, i % planes));
    }
}

}  // namespace OvPlot
