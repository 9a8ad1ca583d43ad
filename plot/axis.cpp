#include "plot/axis.h"

#include <cmath>

#include "tools/numbers/numbers.h"

namespace OvPlot {

namespace {

constexpr double noise = 1e-9;  // of sums and quotients, in steps

Axis steppedTo(double maximum, double step) { return {0, std::ceil(maximum / step - noise) * step, step}; }

}  // namespace

std::vector<double> Axis::ticks() const {
    std::vector<double> values;
    const int count = static_cast<int>(std::lround((last - first) / step));
    for (int i = 0; i <= count; ++i) values.push_back(first + i * step);
    return values;
}

Axis axisTo(double maximum, int most) {
    if (!(maximum > 0) || !std::isfinite(maximum)) maximum = 1;
    for (double power = std::pow(10, std::floor(std::log10(maximum / most)));; power *= 10) {
        for (const double factor : {1.0, 2.0, 2.5, 5.0}) {
            const Axis axis = steppedTo(maximum, factor * power);
            if (axis.last <= (most + noise) * axis.step) return axis;
        }
    }
}

Axis degreeAxis(double first, double last, int most) {
    for (const double step : {5.0, 10.0, 15.0, 30.0, 45.0})
        if (last - first <= most * step) return {first, last, step};
    return {first, last, 90};
}

std::vector<double> roundLevels(double high, int count) {
    std::vector<double> levels;
    if (!(high > 0) || !std::isfinite(high)) return levels;
    for (double power = std::pow(10, std::floor(std::log10(high)));; power /= 10) {
        for (const double factor : {5.0, 2.0, 1.0}) {
            if (static_cast<int>(levels.size()) == count) return levels;
            if (factor * power <= high * (1 + noise)) levels.push_back(factor * power);
        }
    }
}

std::string tickLabel(double value) { return OvTool::shortNumber(value); }

}  // namespace OvPlot
