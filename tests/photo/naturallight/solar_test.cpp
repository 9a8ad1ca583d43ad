#include "components/photo/naturallight/solar.h"

#include <gtest/gtest.h>

#include "tests/photo/naturallight/lightSupport.h"

namespace OvPhotometrics {
namespace {

/// The sun by the low-precision theory of Meeus, Astronomical Algorithms, chapter 25 (0.01 degree): declination in
/// radians and equation of time in hours, for days from 2000 January 1, 12 h UT.
struct TrueSun {
    explicit TrueSun(double days) {
        const double t = days / 36525;
        const double mean = 280.46646 + 36000.76983 * t;
        const double anomaly = inRadians(357.52911 + 35999.05029 * t);
        const double center = (1.914602 - 0.004817 * t) * std::sin(anomaly) + 0.019993 * std::sin(2 * anomaly) +
                              0.000289 * std::sin(3 * anomaly);
        const double node = inRadians(125.04 - 1934.136 * t);
        const double longitude = inRadians(mean + center - 0.00569 - 0.00478 * std::sin(node));
        const double obliquity = inRadians(23.439291 - 0.0130042 * t + 0.00256 * std::cos(node));
        declination = std::asin(std::sin(obliquity) * std::sin(longitude));
        const double ascension = std::atan2(std::cos(obliquity) * std::sin(longitude), std::cos(longitude));
        equationOfTime = std::remainder(mean - 0.0057183 - inDegrees(ascension), 360) / 15;
    }

    double declination;
    double equationOfTime;
};

/// Calls `visit` with the day of a 365-day year and the noon of each day from 2001 to 2004, but 29 February.
template <class Visit>
void forFourYears(Visit visit) {
    for (int i = 0; i < 1461; ++i) {
        const int leapDay = 3 * 365 + 59;
        if (i == leapDay) continue;
        visit((i > leapDay ? i - 1 : i) % 365 + 1, 366.0 + i);
    }
}

TEST(Solar, FitsStayNearTheTrueSun) {
    double worstTime = 0;
    double worstAltitude = 0;
    forFourYears([&](int day, double noon) {
        worstTime = std::max(worstTime, std::abs(equationOfTime(day) - TrueSun(noon).equationOfTime));
        for (const Site& site : sites) {
            for (int hour = 0; hour < 24; hour += 2) {
                const TrueSun sun(noon + (hour + site.zone - 12) / 24);
                const double angle = inRadians(15 * (hour + site.zone - 12 + sun.equationOfTime) - site.longitude);
                const double latitude = inRadians(site.latitude);
                const double altitude =
                    std::asin(std::sin(latitude) * std::sin(sun.declination) +
                              std::cos(latitude) * std::cos(sun.declination) * std::cos(angle));
                const Daylight daylight = computeDaylight(settingsOf(site, day, hour), {});
                worstAltitude = std::max(worstAltitude, std::abs(daylight.solarAltitude - altitude));
            }
        }
    });
    EXPECT_LT(worstTime * 60, 1.2) << "minutes";
    EXPECT_LT(inDegrees(worstAltitude), 1.2) << "degrees";
    RecordProperty("minutes", std::to_string(worstTime * 60));
    RecordProperty("degrees", std::to_string(inDegrees(worstAltitude)));
}

TEST(Solar, PathIsSymmetricAboutNoonAndEndsAtTheHorizon) {
    for (const Site& site : sites) {
        const LatitudeTerms latitude(inRadians(site.latitude));
        for (int day = 1; day <= 365; day += 13) {
            SCOPED_TRACE(site.name + (" on day " + std::to_string(day)));
            const double declination = solarDeclination(day);
            double previous = 4;
            for (double hour = 0; hour <= 12; hour += 0.25) {
                const SolarPosition before = solarPosition(latitude, declination, 12 - hour);
                const SolarPosition after = solarPosition(latitude, declination, 12 + hour);
                EXPECT_NEAR(before.altitude, after.altitude, 1e-12);
                EXPECT_NEAR(std::remainder(before.azimuth + after.azimuth, 2 * pi), 0, 1e-6);
                EXPECT_LT(after.altitude, previous);
                EXPECT_GE(std::sin(after.azimuth), -1e-6);  // in the west
                previous = after.altitude;
            }
            const double sunrise = sunriseSolarTime(latitude, declination);
            if (sunrise > 0 && sunrise < 12) {
                EXPECT_NEAR(solarPosition(latitude, declination, sunrise).altitude, 0, 1e-9);
            } else {
                EXPECT_EQ(solarPosition(latitude, declination, 12).altitude > 0, sunrise == 0);
            }
        }
    }
}

TEST(Solar, PolesAreExact) {
    for (const double beyond : {inRadians(90), inRadians(95), double{toRadians(90)}, HUGE_VAL}) {
        const LatitudeTerms north(beyond);
        const LatitudeTerms south(-beyond);
        for (const int day : {1, 81, 172, 265}) {
            const double declination = solarDeclination(day);
            const bool isEquinox = day == 81 || day == 265;
            for (double hour = 0; hour < 24; ++hour) {
                EXPECT_EQ(solarPosition(south, declination, hour).altitude == 0, isEquinox) << day;
                EXPECT_NEAR(solarPosition(north, declination, hour).altitude, declination, 1e-15);
                EXPECT_NEAR(solarPosition(south, declination, hour).altitude, -declination, 1e-15);
            }
            const double sunrise = isEquinox ? 6 : declination > 0 ? 0 : 12;
            EXPECT_EQ(sunriseSolarTime(north, declination), sunrise) << day;
            EXPECT_EQ(sunriseSolarTime(south, declination), 12 - sunrise) << day;
        }
    }
    EXPECT_EQ(solarDeclination(81), 0);
}

}  // namespace
}  // namespace OvPhotometrics
