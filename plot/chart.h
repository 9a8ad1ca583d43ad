#pragma once

#include "plot/axis.h"
#include "plot/canvas.h"

namespace OvPlot {

/// A rectangle with an axis to the right and one upwards.
struct Chart {
    Box box;
    Axis across;
    Axis up;

    Point at(double x, double y) const {
        return {box.left + across.share(x) * box.width(), box.bottom - up.share(y) * box.height()};
    }
};

/// Lines at all ticks, with their labels beside the box; angles and lengths are labelled without their sign where
/// `absolute`.
void drawGrid(Canvas& canvas, const Chart& chart, bool absolute = true);

}  // namespace OvPlot
