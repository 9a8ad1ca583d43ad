#pragma once

#include "plot/geometry.h"

namespace OvPlot {

/// Values at the crossings of even lines, row after row.
struct Grid {
    std::size_t columns = 0;
    std::size_t rows = 0;
    std::vector<double> values;

    double at(std::size_t column, std::size_t row) const { return values[row * columns + column]; }
};

/// The lines on which the values, linear between neighbours, are `level`; in columns and rows. A line that ends
/// does so at the rim; of others the first point stands at the end again.
std::vector<Path> isolines(const Grid& grid, double level);

}  // namespace OvPlot
