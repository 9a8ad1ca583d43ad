#pragma once

#include <optional>

#include "components/photo/naturallight/sky.h"
#include "ovphoto/naturalLight.h"

// One pass from natural light's settings to all that follows from them.

namespace OvPhotometrics {

/// A result as it is kept.
inline float inSingle(double value) { return static_cast<float>(value); }

/// What the pass gives, in single precision as it is kept. Units and signs: RnNaturalLight.
struct Daylight {
    // Hours.
    float solarTime = 0;
    float localTime = 0;
    float equationOfTime = 0;
    double clockShift = 0;  ///< solar time less clock time
    float sunrise = 0;      ///< clock time, as the next two
    float sunset = 0;
    float solarNoon = 0;

    // Radians.
    float solarAltitude = 0;
    float solarAzimuth = 0;
    float solarZenith = 0;
    std::array<float, 3> sunDirection{0, 0, 1};

    SkyType skyType = SkyType::clear;
    float directNormalIlluminance = 0;
    float directHorizontalIlluminance = 0;
    float skyHorizontalIlluminance = 0;
    float zenithLuminance = 0;
    std::array<float, 6> skyCoefficients{};  ///< see SkyCoefficients
    float maxDirectNormalIlluminance = 0;

    /// The colours over their luminance; white for a colour without any.
    std::array<float, 3> sunColor{1, 1, 1};
    std::array<float, 3> skyColor{1, 1, 1};
};

/// Works out everything. The input is the solar time where one is given, else the settings' local time. Settings
/// out of their range are limited: the day to 1..365, the latitude to the poles, a longitude or meridian of 180
/// degrees or more to -180, the sky cover to 0..1; what is no number or infinite counts as 0.
Daylight computeDaylight(const Ov::NaturalLightSettings& settings, std::optional<float> solarTime);

// Queries of the sky that a pass has given.

/// Luminance in a unit direction of the scene.
double skyLuminance(const Daylight& daylight, const float direction[3]);
/// Luminance by angles in degrees: from the zenith, and azimuth from south towards west, without north.
double skyLuminanceAt(const Daylight& daylight, double zenithAngle, double azimuth);
/// Illuminance of a surface with the unit normal `normal` in the scene; `north` as in the settings.
double skyIlluminance(const Daylight& daylight, const float normal[3], double north);

}  // namespace OvPhotometrics
