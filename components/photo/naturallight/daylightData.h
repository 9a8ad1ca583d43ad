#pragma once

#include "components/photo/lid/lidBuilder.h"
#include "components/photo/naturallight/daylight.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

class DaylightDataPersistant;

/// The natural-light object: settings, and what the pass over them gave last, kept until a setting that it depends
/// on changes.
class DaylightData final
    : public Ov::RnDataObject<DaylightData, DaylightDataPersistant, Ov::RnNaturalLight, Ov::RnNaturalLight> {
public:
    static constexpr BuilderInfo info{classIds::naturalLight, L"Natural Lighting", L"Natural Lighting",
                                      L"Daylight and skylight lighting."};
    static constexpr Ov::RnUid classId = info.classId;

    Ov::RnRef<Ov::RnNaturalLight> clone() const override { return Ov::rnCreate<DaylightData>(*this); }
    void setEnabled(bool on) override { _settings.enabled = on; }
    bool getEnabled() const override { return _settings.enabled; }
    void setOutside(bool outside) override { _settings.outside = outside; }
    bool getOutside() const override { return _settings.outside; }
    void reset() override { setSettings({}); }
    void getSettings(Ov::NaturalLightSettings& settings) const override { settings = _settings; }
    void setSettings(const Ov::NaturalLightSettings& settings) override;

    void setLatitude(float degrees) override;
    float getLatitude() const override;
    void setLongitude(float degrees) override;
    float getLongitude() const override;
    void setNorth(float degrees) override;
    float getNorth() const override;

    void setDayOfYear(std::uint16_t day) override { change(_settings.day, static_cast<std::int16_t>(day)); }
    std::uint16_t getDayOfYear() const override { return static_cast<std::uint16_t>(_settings.day); }
    void setDate(int month, int day) override;
    int getMonth() const override;
    int getDayOfMonth() const override;

    void setTimeZoneHours(float hours) override;
    float getTimeZoneHours() const override;
    void setTimeZone(float degrees) override;
    float getTimeZone() const override;
    void setDaylightSaving(bool on) override { change(_settings.daylightSaving, on); }
    bool getDaylightSaving() const override { return _settings.daylightSaving; }
    void setLocalTime(float hours) override;
    float getLocalTime() const override { return _settings.localTime; }
    void setSolarTime(float hours) override;

    float getSolarTime() override { return derived().solarTime; }
    float getEquationOfTime() override { return derived().equationOfTime; }
    float getSunrise() override { return derived().sunrise; }
    float getSunriseSolarTime() override { return solarTimeOf(derived().sunrise); }
    float getSunset() override { return derived().sunset; }
    float getSunsetSolarTime() override { return solarTimeOf(derived().sunset); }
    float getSolarNoon() override { return derived().solarNoon; }

    void setSkyCover(float cover) override { change(_settings.skyCover, cover); }
    float getSkyCover() const override { return _settings.skyCover; }
    void setSkyShadowAccuracy(float accuracy) override { change(_settings.skyShadowAccuracy, accuracy); }
    float getSkyShadowAccuracy() const override { return _settings.skyShadowAccuracy; }

    bool getSunCastsShadows() const override { return _settings.sunCastsShadows; }
    void setSunCastsShadows(bool on) override { _settings.sunCastsShadows = on; }
    bool getSunFlag2() const override { return _settings.sunFlag2; }
    void setSunFlag2(bool on) override { _settings.sunFlag2 = on; }
    bool getSunFlag3() const override { return _settings.sunFlag3; }
    void setSunFlag3(bool on) override { _settings.sunFlag3 = on; }
    bool getSkyCastsShadows() const override { return _settings.skyCastsShadows; }
    void setSkyCastsShadows(bool on) override { _settings.skyCastsShadows = on; }
    bool getSkyFlag2() const override { return _settings.skyFlag2; }
    void setSkyFlag2(bool on) override { _settings.skyFlag2 = on; }
    bool getSkyFlag3() const override { return _settings.skyFlag3; }
    void setSkyFlag3(bool on) override { _settings.skyFlag3 = on; }

    void setSunColor(const float color[3]) override { change(_settings.sunColor, {color[0], color[1], color[2]}); }
    Triple getSunColor() const override { return _settings.sunColor; }
    void setSkyColor(const float color[3]) override { change(_settings.skyColor, {color[0], color[1], color[2]}); }
    Triple getSkyColor() const override { return _settings.skyColor; }

    void setOverrideSolarPosition(bool on) override { change(_settings.overrideSolarPosition, on); }
    bool getOverrideSolarPosition() const override { return _settings.overrideSolarPosition; }
    void setSolarPosition(float altitude, float azimuth) override;
    float getSolarAltitude() override { return derived().solarAltitude; }
    float getSolarAzimuth() override { return derived().solarAzimuth; }
    float getSolarZenith() override { return derived().solarZenith; }
    Triple getSunDirection() override { return derived().sunDirection; }

    void setOverrideSolarIlluminance(bool on) override { change(_settings.overrideSolarIlluminance, on); }
    bool getOverrideSolarIlluminance() const override { return _settings.overrideSolarIlluminance; }
    void setDirectNormalIlluminance(float lux) override;
    float getDirectNormalIlluminance() override { return derived().directNormalIlluminance; }
    float getDirectHorizontalIlluminance() override { return derived().directHorizontalIlluminance; }
    float getSkyHorizontalIlluminance() override { return derived().skyHorizontalIlluminance; }
    float getZenithLuminance() override { return derived().zenithLuminance; }
    float getMaxDirectNormalIlluminance() override { return derived().maxDirectNormalIlluminance; }

    float getSkyIlluminance(const float normal[3]) override;
    float getSkyLuminance(const float direction[3]) override;
    float getSkyLuminanceAt(float zenithAngle, float azimuth) override;
    void hook() override {}

    /// Whether the derived values belong to the settings; else the next one asked for works them out.
    bool isUpToDate() const { return _valid; }

private:
    template <class T>
    void change(T& setting, const T& value) {
        setting = value;
        _valid = false;
    }
    const Daylight& derived();
    float solarTimeOf(float clockTime) const { return static_cast<float>(clockTime + _derived.clockShift); }

    Ov::NaturalLightSettings _settings;
    Daylight _derived;
    bool _valid = false;
    bool _solarTimeSet = false;  // the solar time in `_derived` is the input, the local time follows
};

/// Saves and loads the settings: a text form in text streams, a binary form otherwise.
class DaylightDataPersistant final : public Ov::RnTempObject<DaylightData> {
public:
    using RnTempObject::RnTempObject;
    /// Raises ExWriteError, after a reported message, where the text form cannot hold a number.
    void save(Ov::RnStream& stream) override;
    /// False after a reported message when the input is refused.
    bool load(Ov::RnStream& stream, int context, const wchar_t* name, const wchar_t* basePath) override;
};

using DaylightBuilder = ObjectBuilder<DaylightData>;

}  // namespace OvPhotometrics
