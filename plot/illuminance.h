#pragma once

#include <cmath>

#include "plot/diagram.h"

namespace OvPlot {

/// On a plane `height` below a luminaire, perpendicular to its axis, where the direction (gamma, C) meets it.
inline double horizontalIlluminance(const Subject& subject, double gamma, double c, double height) {
    const double cosine = std::cos(radians(gamma));
    if (!(cosine > 0)) return 0;
    return subject.intensity(gamma, c) * cosine * cosine * cosine / (height * height);
}

/// The largest on such a plane at 1 m.
inline double largestIlluminance(const Subject& subject) {
    double most = 0;
    for (double c = 0; c < 360; c += 5)
        for (double gamma = 0; gamma < 90; gamma += 0.5)
            most = std::max(most, horizontalIlluminance(subject, gamma, c, 1));
    return most;
}

}  // namespace OvPlot
