#pragma once

#include <numbers>

#include "ovphoto/photoTypes.h"

// Angles as files and webs count them. What is compared or stored is in single precision, what is worked out in double,
// and every step stands in the order that the results depend on.

namespace OvPhotometrics {

using Ov::PhotoWebSymmetry;

// Radians in single precision: the ends of ranges, and where directions are folded.
inline constexpr float halfPi = 1.5707964f;
inline constexpr float pi = 3.1415927f;
inline constexpr float twoPi = 6.2831855f;
inline constexpr float fourPi = 12.566371f;  // the solid angle of the sphere

/// Pi of calculations.
inline constexpr double exactPi = std::numbers::pi;

/// Degrees and radians in double; an angle that is stored is rounded once.
constexpr double inRadians(double degrees) { return degrees * exactPi / 180.0; }
constexpr double inDegrees(double radians) { return radians * 180.0 / exactPi; }
constexpr float toRadians(double degrees) { return static_cast<float>(inRadians(degrees)); }

/// Angles that differ by less count as the same: 0.25 degree, in radians.
inline constexpr double sameAngle = 0.0043633231;

/// -1, 0 or +1 as a lies below, about at or above b, in radians.
constexpr int compareAngles(float a, float b) {
    if (static_cast<double>(b) > a + sameAngle) return -1;
    return a > b + sameAngle ? 1 : 0;
}

/// How far the psi of a symmetry go from 0, in degrees and radians: the circle, its half or quarter, or one plane.
constexpr int psiExtentInDegrees(PhotoWebSymmetry symmetry) {
    switch (symmetry) {
        case PhotoWebSymmetry::Full:
            return 360;
        case PhotoWebSymmetry::Half:
            return 180;
        case PhotoWebSymmetry::Quarter:
            return 90;
        case PhotoWebSymmetry::Axial:
            break;
    }
    return 0;
}
constexpr float psiExtent(PhotoWebSymmetry symmetry) { return toRadians(psiExtentInDegrees(symmetry)); }

static_assert(toRadians(360) == twoPi && toRadians(180) == pi && toRadians(90) == halfPi);

}  // namespace OvPhotometrics
