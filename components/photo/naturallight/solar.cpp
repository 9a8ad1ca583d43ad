#include "components/photo/naturallight/solar.h"

#include <algorithm>
#include <cmath>

#include "components/photo/lid/angles.h"

namespace OvPhotometrics {

namespace {

/// The sine of a declination. On day 265, half a turn behind day 81, a rounded pi leaves it at 5e-17; at a pole, where
/// its sign decides on day and night, that is 0.
double sineOf(double declination, const LatitudeTerms& latitude) {
    const double sine = std::sin(declination);
    return latitude.cosine == 0 && std::abs(sine) < 1e-15 ? 0 : sine;
}

}  // namespace

double equationOfTime(int day) {
    return 0.17 * std::sin(4 * exactPi * (day - 80) / 373) - 0.129 * std::sin(2 * exactPi * (day - 8) / 355);
}

double solarDeclination(int day) { return 0.4093 * std::sin(2 * exactPi * (day - 81) / 368); }

LatitudeTerms::LatitudeTerms(double latitude) {
    const bool isPole = 2 * std::abs(latitude) >= exactPi;
    sine = isPole ? std::copysign(1.0, latitude) : std::sin(latitude);
    cosine = isPole ? 0 : std::cos(latitude);
}

SolarPosition solarPosition(const LatitudeTerms& latitude, double declination, double solarTime) {
    const double hourAngle = solarTime * exactPi / 12;  // from midnight
    const double sineOfDeclination = sineOf(declination, latitude);
    const double cosineOfDeclination = std::cos(declination);
    const double cosineOfHour = std::cos(hourAngle);
    const double sineOfAltitude =
        sineOfDeclination * latitude.sine - cosineOfDeclination * latitude.cosine * cosineOfHour;
    const double west = -cosineOfDeclination * std::sin(hourAngle);
    const double south =
        -(cosineOfDeclination * latitude.sine * cosineOfHour + sineOfDeclination * latitude.cosine);
    return {std::asin(std::clamp(sineOfAltitude, -1.0, 1.0)), std::atan2(west, south)};
}

double sunriseSolarTime(const LatitudeTerms& latitude, double declination) {
    const double above = sineOf(declination, latitude) * latitude.sine;
    const double swing = std::cos(declination) * latitude.cosine;
    // At a pole the swing is 0 and the quotient infinite, unless the sun goes around on the horizon.
    if (std::abs(above) >= swing && above != 0) return above > 0 ? 0 : 12;
    return above == 0 ? 6 : std::acos(above / swing) * 12 / exactPi;
}

}  // namespace OvPhotometrics
