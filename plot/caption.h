#pragma once

#include <optional>
#include <string>
#include <vector>

#include "plot/canvas.h"

namespace OvPlot {

struct LegendItem {
    std::optional<Pen> swatch;
    std::string text;
    bool startsRow = false;
};

/// Title, what is shown, and below the picture a legend, in rows as wide as it is; the room between them.
Box drawCaption(Canvas& canvas, const std::string& title, const std::string& subtitle,
                const std::vector<LegendItem>& legend);

/// The room that a row of the legend has for an item with a swatch.
double legendRoom(const Canvas& canvas);

}  // namespace OvPlot
