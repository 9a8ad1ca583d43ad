#pragma once

#include <string>
#include <vector>

namespace OvPlot {

/// Even ticks of round numbers; `first` and `last` are ticks.
struct Axis {
    double first = 0;
    double last = 1;
    double step = 1;

    std::vector<double> ticks() const;
    /// How far along the axis a value lies: 0 at the first tick, 1 at the last.
    double share(double value) const { return (value - first) / (last - first); }
};

/// From 0 to the first tick at or beyond `maximum`, in `most` steps at most, each 1, 2, 2.5 or 5 times a power of
/// ten. A maximum that is not above 0 counts as 1.
Axis axisTo(double maximum, int most);
/// Of an angle in degrees: the same between two multiples of 90, in steps that divide 90.
Axis degreeAxis(double first, double last, int most);
/// The values 1, 2 and 5 times a power of ten that are at most `high`, highest first.
std::vector<double> roundLevels(double high, int count);

/// As it stands beside a tick: five digits at most.
std::string tickLabel(double value);

}  // namespace OvPlot
