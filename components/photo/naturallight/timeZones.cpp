#include "components/photo/naturallight/timeZones.h"

#include <cmath>
#include <cstdint>

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"
#include "components/photo/lid/angles.h"

namespace OvPhotometrics {

namespace {

struct TimeZone {
    Ov::Message<> name;
    float offset;        // hours, west positive
    float lower, upper;  // bounds of the longitude in degrees, west positive; upper <= lower: across 180 degrees
    std::int32_t flag;
};

constexpr TimeZone zones[] = {
    {messages::zoneNewfoundland, 3.5F, 30, 90, 0},
    {messages::zoneAtlantic, 4, 30, 90, 0},
    {messages::zoneEastern, 5, 45, 105, 0},
    {messages::zoneCentral, 6, 60, 120, 0},
    {messages::zoneMountain, 7, 75, 135, 0},
    {messages::zonePacific, 8, 90, 150, 0},
    {messages::zoneAlaska, 9, 105, 180, 0},
    {messages::zoneHawaii, 10, 120, 180, 0},
    {messages::zoneSamoa, 11, 135, -165, 0},
    {messages::zoneNewZealand, -12, 150, -150, 0},
    {messages::zoneSolomonIslands, -11, 175, -135, 0},
    {messages::zoneEasternAustralia, -10, 180, -120, 0},
    {messages::zoneCentralAustralia, -9.5F, -165, -105, 0},
    {messages::zoneJapan, -9, -165, -105, 0},
    {messages::zoneChina, -8, -150, -60, 0},
    {messages::zoneWesternAustralia, -8, -150, -60, 1},
    {messages::zoneMalaya, -7.5F, -135, -75, 0},
    {messages::zoneIndochina, -7, -135, -60, 0},
    {messages::zoneMyanmar, -6.5F, -120, -60, 0},
    {messages::zoneBangladesh, -6, -120, -60, 0},
    {messages::zoneIndia, -5.5F, -105, -45, 0},
    {messages::zonePakistan, -5, -105, -45, 0},
    {messages::zoneGulf, -4, -90, -30, 0},
    {messages::zoneMoscow, -3, -75, -15, 0},
    {messages::zoneEasternEurope, -2, -60, 0, 0},
    {messages::zoneSouthAfrica, -2, -60, 0, 1},
    {messages::zoneCentralEurope, -1, -45, 15, 0},
    {messages::zoneGreenwich, 0, -30, 30, 0},
    {messages::zoneAzores, 1, -15, 45, 0},
    {messages::zoneMidAtlantic, 2, 0, 60, 0},
    {messages::zoneBrasilia, 3, 0, 90, 0},
};

constexpr int zoneCount = std::size(zones);

/// The row of a valid index, or null.
const TimeZone* findZone(int index) { return index >= 0 && index < zoneCount ? &zones[index] : nullptr; }

}  // namespace

int getTimeZoneCount() { return zoneCount; }

const wchar_t* getTimeZoneName(int index) {
    const TimeZone* zone = findZone(index);
    return zone ? Ov::keptText(zone->name) : L"";
}

int getTimeZoneFlag(int index) {
    const TimeZone* zone = findZone(index);
    return zone ? zone->flag : 0;
}

float getTimeZoneMeridian(int index) {
    const TimeZone* zone = findZone(index);
    return zone ? zone->offset * pi / 12.0F : 0;
}

int findTimeZone(float meridian) {
    // In double, rounded once: a meridian midway between two zones then lies exactly midway.
    const auto hours = static_cast<float>(meridian * 12.0 / exactPi);
    int nearest = 0;
    for (int i = 1; i < zoneCount; ++i) {
        if (std::abs(zones[i].offset - hours) < std::abs(zones[nearest].offset - hours)) nearest = i;
    }
    return nearest;
}

bool isInTimeZone(int index, float longitude) {
    const TimeZone* zone = findZone(index);
    if (!zone) return false;
    const bool wraps = zone->upper <= zone->lower;
    if (wraps && longitude < 0) longitude += 360;
    return longitude > zone->lower && longitude < zone->upper + (wraps ? 360.0F : 0.0F);
}

}  // namespace OvPhotometrics
