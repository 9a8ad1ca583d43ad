#pragma once

#include <cmath>
#include <numbers>

#include "ovphoto/intensityDist.h"

namespace OvPlot {

using Vector = Ov::GeVector3<double>;

inline double radians(double degrees) { return degrees * std::numbers::pi / 180; }
inline double degrees(double radians) { return radians * 180 / std::numbers::pi; }

/// The intensity of a luminaire towards a direction of its local frame.
inline float intensityTowards(const Ov::RnIntensityDist& luminaire, const Vector& direction) {
    const auto [x, y, z] = direction;
    return luminaire.localIntensity(static_cast<float>(std::atan2(std::hypot(x, y), z)),
                                static_cast<float>(std::atan2(y, x)));
}

/// The angles of diagrams in the local frame of a luminaire: gamma counts from `down`, planes C around it from `c0`
/// towards `c90`. The three are orthogonal unit vectors.
struct LuminaireFrame {
    Vector down{0, 0, 1};
    Vector c0{1, 0, 0};
    Vector c90{0, 1, 0};
    bool aimed = false;  // `down` is the axis of a floodlight, C0 horizontal and C90 upwards

    Vector direction(double gamma, double c) const {
        const double along = std::cos(radians(gamma));
        const double x = std::sin(radians(gamma)) * std::cos(radians(c));
        const double y = std::sin(radians(gamma)) * std::sin(radians(c));
        return {along * down.x + x * c0.x + y * c90.x, along * down.y + x * c0.y + y * c90.y,
                along * down.z + x * c0.z + y * c90.z};
    }
};

/// The angle between two directions of a plane, in degrees from the axis: negative towards C + 180.
struct AngleSpan {
    double first = 0;
    double last = 0;

    double width() const { return last - first; }
};

}  // namespace OvPlot
