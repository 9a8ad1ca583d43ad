#include "plot/chart.h"

#include <cmath>

namespace OvPlot {

void drawGrid(Canvas& canvas, const Chart& chart, bool absolute) {
    const Font font = canvas.mutedFont(12);
    const auto penAt = [&](double tick) {
        return Pen{tick == 0 ? canvas.palette().muted : canvas.palette().grid};
    };
    const auto shown = [absolute](double tick) { return tickLabel(absolute ? std::abs(tick) : tick); };
    for (const double tick : chart.across.ticks()) {
        const double x = chart.at(tick, 0).x;
        canvas.line({x, chart.box.top}, {x, chart.box.bottom}, penAt(tick));
        canvas.text({x, chart.box.bottom + 15}, shown(tick), font, Align::centre);
    }
    for (const double tick : chart.up.ticks()) {
        const double y = chart.at(0, tick).y;
        canvas.line({chart.box.left, y}, {chart.box.right, y}, penAt(tick));
        canvas.text({chart.box.left - 8, y}, shown(tick), font, Align::right);
    }
}

}  // namespace OvPlot
