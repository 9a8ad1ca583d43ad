#pragma once

#include <array>
#include <cstdint>

#include "host/componentManager/castable.h"

namespace Ov {

/// What natural light is worked out from: site, date, time and sky. Angles are radians here; the interface speaks
/// degrees. The defaults are those of a new object.
struct NaturalLightSettings {
    bool enabled = true;             ///< for the host; nothing here depends on it
    bool outside = false;            ///< false: "In", true: "Out"
    float north = 0;                 ///< added to a solar azimuth to turn it into the scene
    float latitude = 0.7155850f;     ///< north positive (41 degrees)
    float longitude = 1.2915436f;    ///< west positive (74 degrees)
    std::int16_t day = 172;          ///< of a year of 365 days, 1 = 1 January (21 June)
    bool daylightSaving = true;      ///< the clock is one hour ahead
    float localTime = 10;            ///< what the clock shows, hours
    float timeZone = 1.3089969f;     ///< meridian of the time zone, west positive (75 degrees)
    float skyCover = 0;              ///< 0 clear to 1 overcast
    float skyShadowAccuracy = 0.5f;  ///< for the host's renderer, as are the flags

    /// @{
    /// Flags for the host's renderer: the first of sun and sky says whether it casts shadows.
    bool sunCastsShadows = true;
    bool sunFlag2 = true;
    bool sunFlag3 = true;
    bool skyCastsShadows = false;
    bool skyFlag2 = true;
    bool skyFlag3 = false;
    /// @}

    std::array<float, 3> sunColor{1.0f, 0.95f, 0.9f};   ///< relative r, g, b
    std::array<float, 3> skyColor{0.95f, 0.95f, 1.0f};  ///< the same of the sky
    bool overrideSolarPosition = false;                 ///< take the two angles below as they are
    float solarAltitude = 0;                            ///< above the horizon
    float solarAzimuth = 0;                             ///< 0 = south, positive towards west
    bool overrideSolarIlluminance = false;              ///< take the value below as it is
    float directNormalIlluminance = 0;                  ///< lux

    /// Whether every setting is the same.
    friend bool operator==(const NaturalLightSettings&, const NaturalLightSettings&) = default;
};

/// The sun and the sky over a site at a time: settings, and what follows from them.
///
/// Units:    degrees, except the solar angles (`setSolarPosition`, `getSolarAltitude`, `getSolarAzimuth`,
///           `getSolarZenith`), which are radians; decimal hours; lux; candela per square metre.
/// Signs:    latitude north positive; longitude and time zone WEST positive (New York: longitude 74, zone 5 hours).
/// Azimuth:  0 = south, positive towards west, before `north` is added.
/// Scene:    with `north` 0, +X points east, +Y north, +Z up. Directions are scene directions, towards the light.
/// Range:    setters take any value and getters give it back; only the computation limits it (day 1 to 365,
///           latitude to the poles, a longitude or meridian from 180 degrees on counts as -180, sky cover 0 to 1).
///           Numbers that are not finite cannot be saved as text: ExWriteError, after message 13081.
/// Lazy:     the values below "derived" are computed together by the first of them that is asked for after a change,
///           which is why those operations are not const. Getters of settings never compute: after `setSolarTime`
///           the local time follows when a derived value is next asked for.
/// Threads:  one at a time for an object, as getters compute; any number with objects of their own.
class RnNaturalLight : public RnCastable {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0xfa9afdd0, 0xc33911d1, 0xaa7c00c0, 0x4fb1532a};
    /// x, y, z or r, g, b.
    using Triple = std::array<float, 3>;

    /// A new object in the same state; where the solar time was given it stays the input.
    virtual RnRef<RnNaturalLight> clone() const = 0;

    /// @{
    /// Whether the host uses the light; nothing here depends on it.
    virtual void setEnabled(bool on) = 0;
    virtual bool getEnabled() const = 0;
    /// @}

    /// @{
    /// False: "In", true: "Out".
    virtual void setOutside(bool outside) = 0;
    virtual bool getOutside() const = 0;
    /// @}

    /// Every setting takes its default; the local time is the input.
    virtual void reset() = 0;

    /// @{
    /// All settings at once, angles in radians. Setting them makes the local time the input.
    virtual void getSettings(NaturalLightSettings& settings) const = 0;
    virtual void setSettings(const NaturalLightSettings& settings) = 0;
    /// @}

    /// @{
    /// Site, degrees.
    virtual void setLatitude(float degrees) = 0;
    virtual float getLatitude() const = 0;
    virtual void setLongitude(float degrees) = 0;
    virtual float getLongitude() const = 0;
    virtual void setNorth(float degrees) = 0;
    virtual float getNorth() const = 0;
    /// @}

    // Date, in a year of 365 days.
    /// @{
    /// Day 1 is 1 January; any value is taken.
    virtual void setDayOfYear(std::uint16_t day) = 0;
    virtual std::uint16_t getDayOfYear() const = 0;
    /// @}

    /// A date that does not exist sets day 0.
    virtual void setDate(int month, int day) = 0;

    /// @{
    /// The stored day as a date; 0 when it is none of 1 to 365.
    virtual int getMonth() const = 0;
    virtual int getDayOfMonth() const = 0;
    /// @}

    /// @{
    /// Time. The time zone's meridian in hours (15 degrees each) or in degrees.
    virtual void setTimeZoneHours(float hours) = 0;
    virtual float getTimeZoneHours() const = 0;
    virtual void setTimeZone(float degrees) = 0;
    virtual float getTimeZone() const = 0;
    /// @}

    /// @{
    /// Whether the clock is an hour ahead.
    virtual void setDaylightSaving(bool on) = 0;
    virtual bool getDaylightSaving() const = 0;
    /// @}

    /// @{
    /// The clock's time, hours; the solar time then follows from it.
    virtual void setLocalTime(float hours) = 0;
    virtual float getLocalTime() const = 0;
    /// @}

    /// The solar time, hours (12: the sun is due south); the local time then follows from it.
    virtual void setSolarTime(float hours) = 0;

    /// @{
    /// Derived, hours. Sunrise, sunset and noon are clock times; without a sunrise the sun rises and sets at solar
    /// time 0 and 24 (it stays up) or at 12 (it stays down).
    virtual float getSolarTime() = 0;
    virtual float getEquationOfTime() = 0;
    virtual float getSunrise() = 0;
    virtual float getSunriseSolarTime() = 0;
    virtual float getSunset() = 0;
    virtual float getSunsetSolarTime() = 0;
    virtual float getSolarNoon() = 0;
    /// @}

    /// @{
    /// Sky: 0 clear to 1 overcast. Clear below 0.35, overcast above 0.75, partly cloudy between.
    virtual void setSkyCover(float cover) = 0;
    virtual float getSkyCover() const = 0;
    /// @}

    /// @{
    /// For the host's renderer.
    virtual void setSkyShadowAccuracy(float accuracy) = 0;
    virtual float getSkyShadowAccuracy() const = 0;
    /// @}

    /// @{
    /// Flags for the host's renderer; nothing here depends on them.
    virtual bool getSunCastsShadows() const = 0;
    virtual void setSunCastsShadows(bool on) = 0;
    virtual bool getSunFlag2() const = 0;
    virtual void setSunFlag2(bool on) = 0;
    virtual bool getSunFlag3() const = 0;
    virtual void setSunFlag3(bool on) = 0;
    virtual bool getSkyCastsShadows() const = 0;
    virtual void setSkyCastsShadows(bool on) = 0;
    virtual bool getSkyFlag2() const = 0;
    virtual void setSkyFlag2(bool on) = 0;
    virtual bool getSkyFlag3() const = 0;
    virtual void setSkyFlag3(bool on) = 0;
    /// @}

    /// @{
    /// Colours, relative r, g, b.
    virtual void setSunColor(const float color[3]) = 0;
    virtual Triple getSunColor() const = 0;
    virtual void setSkyColor(const float color[3]) = 0;
    virtual Triple getSkyColor() const = 0;
    /// @}

    /// @{
    /// Position of the sun. While the override is on, the derived altitude and azimuth are those last set.
    virtual void setOverrideSolarPosition(bool on) = 0;
    virtual bool getOverrideSolarPosition() const = 0;
    /// @}

    /// RADIANS; azimuth 0 = south, positive towards west.
    virtual void setSolarPosition(float altitude, float azimuth) = 0;

    /// @{
    /// Derived, RADIANS; the azimuth is without `north`, the zenith angle is pi/2 less the altitude.
    virtual float getSolarAltitude() = 0;
    virtual float getSolarAzimuth() = 0;
    virtual float getSolarZenith() = 0;
    /// @}

    /// Derived: unit direction towards the sun in the scene, `north` applied.
    virtual Triple getSunDirection() = 0;

    /// @{
    /// Illuminance, lux. While the override is on, the direct normal illuminance is the one last set.
    virtual void setOverrideSolarIlluminance(bool on) = 0;
    virtual bool getOverrideSolarIlluminance() const = 0;
    virtual void setDirectNormalIlluminance(float lux) = 0;
    /// @}

    /// @{
    /// Derived: the sun on a surface that faces it, and on the ground; the sky on the ground.
    virtual float getDirectNormalIlluminance() = 0;
    virtual float getDirectHorizontalIlluminance() = 0;
    virtual float getSkyHorizontalIlluminance() = 0;
    /// @}

    /// Derived: luminance of the sky overhead, candela per square metre.
    virtual float getZenithLuminance() = 0;
    /// What the sun gives outside the atmosphere when it is nearest, lux: always 131835.
    virtual float getMaxDirectNormalIlluminance() = 0;

    // The sky's light, derived.
    /// Illuminance of a surface by the sky alone, lux; `normal` is a unit vector in the scene.
    virtual float getSkyIlluminance(const float normal[3]) = 0;
    /// Luminance of the sky in a unit direction of the scene, candela per square metre; 0 at and below the
    /// horizon.
    virtual float getSkyLuminance(const float direction[3]) = 0;
    /// The same by angles in DEGREES: from the zenith, and azimuth from south towards west, without `north`.
    virtual float getSkyLuminanceAt(float zenithAngle, float azimuth) = 0;

    /// For the host's use; does nothing.
    virtual void hook() = 0;
};

}  // namespace Ov
