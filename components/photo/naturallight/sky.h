#pragma once

#include <array>

// The light of the sun and of three kinds of sky: the IES daylight model (IES RP-21, Recommended Practice for the
// Calculation of Daylight Availability, 1984), with the luminance distributions of the CIE clear sky (Kittler; CIE
// 22, 1973), Pierpoint's partly cloudy sky, and the overcast sky of Moon and Spencer (1942) in an exponential
// form.
//
// Units:    radians; lux; candela per square metre.
// Accuracy: the luminance of a sky, summed over a hemisphere, gives its horizontal illuminance within 0.2 % at
//           solar altitudes that are multiples of 5 degrees, where the zenith luminance is tabulated, and within
//           0.9 % (clear) and 0.3 % (partly cloudy) between; the overcast sky gives 1.049 of it. sky_test measures
//           it.

namespace OvPhotometrics {

using Vector = std::array<double, 3>;

enum class SkyType { clear, partlyCloudy, overcast };

/// The kind of sky for a sky cover 0..1: clear below 0.35, overcast above 0.75.
SkyType skyTypeOf(float cover);

/// What the sun gives outside the atmosphere at its mean distance and when it is nearest.
inline constexpr double solarIlluminance = 127500;
inline constexpr double maxSolarIlluminance = solarIlluminance * 1.034;

/// Illuminance by the sun on a surface that faces it; 0 below the horizon and behind an overcast sky.
double directNormalIlluminance(SkyType type, double altitude, int day);

/// Illuminance of the ground by the whole sky.
double skyHorizontalIlluminance(SkyType type, double altitude);

/// Luminance of the sky overhead, from the sky's horizontal illuminance.
double zenithLuminance(SkyType type, double altitude, double horizontal);

/// A sky's luminance distribution, and the half-sky illuminances of the same model.
///   0, 1   scale of the distribution; the overcast one is a sum of two terms
///   2, 3   terms of the half-sky illuminance of a vertical surface (kept, not used here)
///   4, 5   terms of the half-sky illuminance of the ground (kept, not used here)
using SkyCoefficients = std::array<double, 6>;

/// All 0 when the sun is not above the horizon; the sky is then dark.
SkyCoefficients skyCoefficients(SkyType type, double altitude, double zenithLuminance);

struct SkyModel {
    SkyType type = SkyType::clear;
    SkyCoefficients c{};
};

/// Luminance towards a direction by the cosines of its angles from the zenith and from the sun; 0 at and below the
/// horizon, and for what is no number.
double skyLuminance(const SkyModel& sky, double cosineOfZenith, double cosineOfSun);

/// Illuminance of a surface with the unit normal `normal`: the sum over 32 bands of 128 directions each. `sun` is
/// the unit direction towards the sun. Both are scene directions, z up; the sampled azimuths, of which 0 is -y and
/// pi/2 is -x, are the odd multiples of pi/128 less `north`.
double skyIlluminance(const SkyModel& sky, const Vector& sun, const Vector& normal, double north);

}  // namespace OvPhotometrics
