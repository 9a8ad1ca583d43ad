#include "components/photo/naturallight/clock.h"

#include <cmath>

namespace OvPhotometrics {

namespace {

constexpr int minutesInHour = 60;
constexpr float minutesInDay = 1440;

/// The minute of the day nearest to `hours`, 0..1439.
int nearestMinute(float hours) {
    const float minute = std::fmod(std::floor(hours * 60.0F + 0.5F), minutesInDay);
    if (!std::isfinite(minute)) return 0;
    return static_cast<int>(minute < 0 ? minute + minutesInDay : minute);
}

}  // namespace

float hoursMinutesToDecimal(bool twelveHour, int hours, int minutes, bool pm) {
    const int hour = twelveHour ? hours % 12 + (pm ? 12 : 0) : hours % 24;
    const float decimal = static_cast<float>(hour) + static_cast<float>(minutes) / 60.0F;
    return decimal >= 24 ? decimal - 24 : decimal;
}

void decimalToHoursMinutes(bool twelveHour, float decimalHours, int* hours, int* minutes, bool* pm) {
    const int total = nearestMinute(decimalHours);
    const int hour = total / minutesInHour;
    const bool afternoon = hour >= 12;
    if (hours) *hours = twelveHour && afternoon ? hour - 12 : hour;
    if (minutes) *minutes = total % minutesInHour;
    if (pm && twelveHour) *pm = afternoon;
}

}  // namespace OvPhotometrics
