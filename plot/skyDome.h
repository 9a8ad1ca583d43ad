#pragma once

#include <array>

#include "plot/canvas.h"
#include "plot/luminaireFrame.h"

namespace OvPlot {

/// The sky's half sphere on paper. Azimuths count from south towards west, as natural light has them.
struct SkyDome {
    Point centre;
    double radius = 1;
    bool mirrored = false;  // seen from below: east on the left

    /// Degrees.
    Point at(double altitude, double azimuth) const {
        const double r = radius * (90 - altitude) / 90;
        const double x = -r * std::sin(radians(azimuth));
        return centre + Point{mirrored ? -x : x, r * std::cos(radians(azimuth))};
    }
    /// The point `beyond` the horizon.
    Point outside(double beyond, double azimuth) const { return at(-90 * beyond / radius, azimuth); }
};

struct CompassPoint {
    const char* name;
    double azimuth;
};
inline std::array<CompassPoint, 4> compassPoints(const char* east) {
    return {{{"N", 180}, {east, -90}, {"S", 0}, {"W", 90}}};
}

}  // namespace OvPlot
