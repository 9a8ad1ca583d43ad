#pragma once

#include "components/photo/lid/photoWeb.h"
#include "components/photo/naturallight/daylight.h"

namespace OvPhotometrics {

/// A place with its clock; degrees and hours, west positive.
struct Site {
    const char* name;
    double latitude, longitude, zone;
};

inline constexpr Site sites[] = {
    {"Quito", -0.2, 78.5, 5},       {"Singapore", 1.3, -103.8, -8}, {"Cairo", 30, -31.2, -2},
    {"Sydney", -33.9, -151.2, -10}, {"New York", 40.7, 74, 5},      {"Berlin", 52.5, -13.4, -1},
    {"Ushuaia", -54.8, 68.3, 3},    {"Tromso", 69.6, -19, -1},      {"McMurdo", -77.8, -166.7, -12},
};

/// Settings of a place without daylight saving, under a clear sky.
inline Ov::NaturalLightSettings settingsOf(const Site& site, int day, double localTime = 12) {
    Ov::NaturalLightSettings settings;
    settings.latitude = toRadians(site.latitude);
    settings.longitude = toRadians(site.longitude);
    settings.timeZone = toRadians(site.zone * 15);
    settings.day = static_cast<std::int16_t>(day);
    settings.localTime = static_cast<float>(localTime);
    settings.daylightSaving = false;
    return settings;
}

}  // namespace OvPhotometrics
