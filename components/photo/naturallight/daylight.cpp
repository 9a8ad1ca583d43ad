#include "components/photo/naturallight/daylight.h"

#include <algorithm>
#include <cmath>

#include "components/photo/lid/angles.h"
#include "components/photo/naturallight/calendar.h"
#include "components/photo/naturallight/solar.h"

namespace OvPhotometrics {

namespace {

double finite(float value) { return std::isfinite(value) ? value : 0; }

/// A longitude or meridian: 180 degrees and beyond count as -180.
double meridian(float value) {
    if (std::abs(value) >= exactPi) return -pi;
    return finite(value);
}

double latitudeOf(float value) { return std::isnan(value) ? 0 : value; }

float coverOf(float value) { return value > 0 ? std::min(value, 1.0f) : 0; }

/// Solar time and clock, both ways. The solar time in full precision is the result.
double tellTime(Daylight& out, const Ov::NaturalLightSettings& in, std::optional<float> solarTime, int day) {
    const double equation = equationOfTime(day);
    const double toMeridian = (meridian(in.timeZone) - meridian(in.longitude)) * 12 / exactPi;
    const double saving = in.daylightSaving ? 1 : 0;
    out.equationOfTime = inSingle(equation);
    out.clockShift = equation + toMeridian - saving;
    if (solarTime) {
        out.solarTime = *solarTime;
        out.localTime = inSingle(finite(*solarTime) + saving - equation - toMeridian);
        return finite(*solarTime);
    }
    const double time = finite(in.localTime) - saving + equation + toMeridian;
    out.solarTime = inSingle(time);
    out.localTime = in.localTime;
    return time;
}

/// Where the sun stands, and when it crosses the horizon. Altitude and azimuth in full precision are the result.
SolarPosition placeSun(Daylight& out, const Ov::NaturalLightSettings& in, double solarTime, int day) {
    const LatitudeTerms latitude(latitudeOf(in.latitude));
    const double declination = solarDeclination(day);
    SolarPosition sun{finite(in.solarAltitude), finite(in.solarAzimuth)};
    if (!in.overrideSolarPosition) sun = solarPosition(latitude, declination, solarTime);
    out.solarAltitude = inSingle(sun.altitude);
    out.solarAzimuth = inSingle(sun.azimuth);
    out.solarZenith = inSingle(exactPi / 2 - sun.altitude);
    const double turned = sun.azimuth + finite(in.north);
    const double across = std::cos(sun.altitude);
    out.sunDirection = {inSingle(-std::sin(turned) * across), inSingle(-std::cos(turned) * across),
                        inSingle(std::sin(sun.altitude))};
    const double sunrise = sunriseSolarTime(latitude, declination);
    out.sunrise = inSingle(sunrise - out.clockShift);
    out.sunset = inSingle(24 - sunrise - out.clockShift);
    out.solarNoon = inSingle(12 - out.clockShift);
    return sun;
}

void addIlluminances(Daylight& out, const Ov::NaturalLightSettings& in, double altitude, int day) {
    out.skyType = skyTypeOf(coverOf(in.skyCover));
    const double direct = in.overrideSolarIlluminance ? finite(in.directNormalIlluminance)
                                                      : directNormalIlluminance(out.skyType, altitude, day);
    const double horizontal = skyHorizontalIlluminance(out.skyType, altitude);
    const double zenith = zenithLuminance(out.skyType, altitude, horizontal);
    out.directNormalIlluminance = inSingle(direct);
    out.directHorizontalIlluminance = inSingle(std::sin(altitude) * direct + 0.0);  // at night no -0
    out.skyHorizontalIlluminance = inSingle(horizontal);
    out.zenithLuminance = inSingle(zenith);
    out.maxDirectNormalIlluminance = inSingle(maxSolarIlluminance);
    std::ranges::transform(skyCoefficients(out.skyType, altitude, zenith), out.skyCoefficients.begin(), inSingle);
}

/// A colour over its luminance.
std::array<float, 3> normalized(const std::array<float, 3>& color) {
    const double luminance = 0.263 * std::abs(color[0]) + 0.655 * std::abs(color[1]) + 0.082 * std::abs(color[2]);
    if (!(luminance >= 0.0001) || !std::isfinite(luminance)) return {1, 1, 1};
    return {inSingle(color[0] / luminance), inSingle(color[1] / luminance), inSingle(color[2] / luminance)};
}

SkyModel modelOf(const Daylight& daylight) {
    SkyModel sky{daylight.skyType, {}};
    std::ranges::copy(daylight.skyCoefficients, sky.c.begin());
    return sky;
}

Vector vectorOf(const float v[3]) { return {v[0], v[1], v[2]}; }

}  // namespace

Daylight computeDaylight(const Ov::NaturalLightSettings& settings, std::optional<float> solarTime) {
    Daylight out;
    const int day = std::clamp<int>(settings.day, 1, daysInYear);
    const double time = tellTime(out, settings, solarTime, day);
    const SolarPosition sun = placeSun(out, settings, time, day);
    addIlluminances(out, settings, sun.altitude, day);
    out.sunColor = normalized(settings.sunColor);
    out.skyColor = normalized(settings.skyColor);
    return out;
}

double skyLuminance(const Daylight& daylight, const float direction[3]) {
    const Vector d = vectorOf(direction);
    const Vector sun = vectorOf(daylight.sunDirection.data());
    return skyLuminance(modelOf(daylight), d[2], d[0] * sun[0] + d[1] * sun[1] + d[2] * sun[2]);
}

double skyLuminanceAt(const Daylight& daylight, double zenithAngle, double azimuth) {
    const double angle = inRadians(zenithAngle);
    // As a sine, so that it is exactly 0 at the horizon.
    const double cosine = std::sin(inRadians(90 - zenithAngle));
    const double zenith = daylight.solarZenith;
    const double cosineOfSun =
        std::sin(zenith) * std::sin(angle) * std::cos(daylight.solarAzimuth - inRadians(azimuth)) +
        std::cos(zenith) * cosine;
    return skyLuminance(modelOf(daylight), cosine, cosineOfSun);
}

double skyIlluminance(const Daylight& daylight, const float normal[3], double north) {
    return skyIlluminance(modelOf(daylight), vectorOf(daylight.sunDirection.data()), vectorOf(normal),
                          std::isfinite(north) ? north : 0);
}

}  // namespace OvPhotometrics
