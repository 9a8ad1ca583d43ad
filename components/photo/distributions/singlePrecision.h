#pragma once

#include <cmath>

// Functions of single-precision numbers: the double ones, rounded once. Platforms' own differ in the last digit.

namespace OvPhotometrics::single {

inline float sine(double angle) { return static_cast<float>(std::sin(angle)); }
inline float cosine(double angle) { return static_cast<float>(std::cos(angle)); }
inline float arcCosine(double cosine) { return static_cast<float>(std::acos(cosine)); }
inline float arcTangent(double y, double x) { return static_cast<float>(std::atan2(y, x)); }
inline float logarithm(double value) { return static_cast<float>(std::log(value)); }
inline float power(double base, double exponent) { return static_cast<float>(std::pow(base, exponent)); }

}  // namespace OvPhotometrics::single

namespace OvPhotometrics {

/// An intensity or flux; 0 where it is no number, as a dark direction is at an infinite candela.
inline float orDark(float light) { return light == light ? light : 0; }

}  // namespace OvPhotometrics
