#include "components/photo/naturallight/daylightData.h"

#include "components/photo/lid/angles.h"
#include "components/photo/naturallight/calendar.h"
#include "components/photo/naturallight/daylightForms.h"
#include "host/componentManager/stream.h"

namespace OvPhotometrics {

namespace {

constexpr double degreesPerHour = 15;

float toDegrees(float radians) { return inSingle(inDegrees(radians)); }

}  // namespace

void DaylightData::setSettings(const Ov::NaturalLightSettings& settings) {
    change(_settings, settings);
    _solarTimeSet = false;
}

void DaylightData::setLatitude(float degrees) { change(_settings.latitude, toRadians(degrees)); }
float DaylightData::getLatitude() const { return toDegrees(_settings.latitude); }
void DaylightData::setLongitude(float degrees) { change(_settings.longitude, toRadians(degrees)); }
float DaylightData::getLongitude() const { return toDegrees(_settings.longitude); }
void DaylightData::setNorth(float degrees) { change(_settings.north, toRadians(degrees)); }
float DaylightData::getNorth() const { return toDegrees(_settings.north); }

void DaylightData::setDate(int month, int day) {
    change(_settings.day, static_cast<std::int16_t>(dayOfYear(month, day)));
}

int DaylightData::getMonth() const {
    int month = 0;
    monthAndDay(_settings.day, &month, nullptr);
    return month;
}

int DaylightData::getDayOfMonth() const {
    int day = 0;
    monthAndDay(_settings.day, nullptr, &day);
    return day;
}

void DaylightData::setTimeZoneHours(float hours) {
    change(_settings.timeZone, toRadians(degreesPerHour * static_cast<double>(hours)));
}
float DaylightData::getTimeZoneHours() const { return inSingle(inDegrees(_settings.timeZone) / degreesPerHour); }
void DaylightData::setTimeZone(float degrees) { change(_settings.timeZone, toRadians(degrees)); }
float DaylightData::getTimeZone() const { return toDegrees(_settings.timeZone); }

void DaylightData::setLocalTime(float hours) {
    change(_settings.localTime, hours);
    _solarTimeSet = false;
}

void DaylightData::setSolarTime(float hours) {
    change(_derived.solarTime, hours);
    _solarTimeSet = true;
}

void DaylightData::setSolarPosition(float altitude, float azimuth) {
    _settings.solarAltitude = altitude;
    _settings.solarAzimuth = azimuth;
    if (_settings.overrideSolarPosition) _valid = false;
}

void DaylightData::setDirectNormalIlluminance(float lux) {
    _settings.directNormalIlluminance = lux;
    if (_settings.overrideSolarIlluminance) _valid = false;
}

float DaylightData::getSkyIlluminance(const float normal[3]) {
    return inSingle(skyIlluminance(derived(), normal, _settings.north));
}

float DaylightData::getSkyLuminance(const float direction[3]) {
    return inSingle(skyLuminance(derived(), direction));
}

float DaylightData::getSkyLuminanceAt(float zenithAngle, float azimuth) {
    return inSingle(skyLuminanceAt(derived(), zenithAngle, azimuth));
}

const Daylight& DaylightData::derived() {
    if (_valid) return _derived;
    _derived = computeDaylight(_settings, _solarTimeSet ? std::optional(_derived.solarTime) : std::nullopt);
    _settings.localTime = _derived.localTime;
    _valid = true;
    return _derived;
}

void DaylightDataPersistant::save(Ov::RnStream& stream) {
    Ov::NaturalLightSettings settings;
    data().getSettings(settings);
    if (!stream.isTextStream()) return writeDaylightBinary(stream, settings);
    if (!writeDaylightText(stream, settings))
        throw Ov::RnStreamEx::ExWriteError("components/photo/naturallight/daylightData", __LINE__,
                                           "natural light stream");
}

bool DaylightDataPersistant::load(Ov::RnStream& stream, int, const wchar_t*, const wchar_t*) {
    const auto settings = stream.isTextStream() ? readDaylightText(stream) : readDaylightBinary(stream);
    if (settings) data().setSettings(*settings);
    return settings.has_value();
}

}  // namespace OvPhotometrics
