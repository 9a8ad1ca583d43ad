#include "components/photo/naturallight/daylightData.h"

#include <climits>
#include <limits>
#include <numbers>
#include <set>

#include "components/photo/naturallight/calendar.h"
#include "components/photo/naturallight/clock.h"
#include "components/photo/naturallight/sky.h"
#include "components/photo/naturallight/solar.h"
#include "components/photo/naturallight/timeZones.h"
#include "tests/photo/photoFixture.h"

// The sun, the sky, the object that holds their settings, and the calendar.

namespace OvPhotometrics {
namespace {

/// A place with its clock; degrees and hours, west positive.
struct Site {
    const char* name;
    double latitude, longitude, zone;
};

constexpr Site sites[] = {
    {"Quito", -0.2, 78.5, 5},       {"Singapore", 1.3, -103.8, -8}, {"Cairo", 30, -31.2, -2},
    {"Sydney", -33.9, -151.2, -10}, {"New York", 40.7, 74, 5},      {"Berlin", 52.5, -13.4, -1},
    {"Ushuaia", -54.8, 68.3, 3},    {"Tromso", 69.6, -19, -1},      {"McMurdo", -77.8, -166.7, -12},
};

/// Settings of a place without daylight saving, under a clear sky.
Ov::NaturalLightSettings settingsOf(const Site& site, int day, double localTime = 12) {
    Ov::NaturalLightSettings settings;
    settings.latitude = toRadians(site.latitude);
    settings.longitude = toRadians(site.longitude);
    settings.timeZone = toRadians(site.zone * 15);
    settings.day = static_cast<std::int16_t>(day);
    settings.localTime = static_cast<float>(localTime);
    settings.daylightSaving = false;
    return settings;
}

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

/// A sky with the sun overridden to an altitude and azimuth in degrees.
Daylight skyWith(float cover, double altitude, double azimuth = 0, double north = 0) {
    Ov::NaturalLightSettings settings;
    settings.skyCover = cover;
    settings.overrideSolarPosition = true;
    settings.solarAltitude = toRadians(altitude);
    settings.solarAzimuth = toRadians(azimuth);
    settings.north = toRadians(north);
    return computeDaylight(settings, {});
}

constexpr float covers[] = {0, 0.5f, 1};
constexpr float up[3] = {0, 0, 1};

TEST(Sky, LuminanceAddsUpToTheHorizontalIlluminance) {
    const double between[] = {0.009, 0.003};  // clear, partly cloudy
    for (double altitude = 2.5; altitude <= 90; altitude += 2.5) {
        SCOPED_TRACE(altitude);
        const bool isTabulated = std::fmod(altitude, 5) == 0;
        for (int i = 0; i < 2; ++i) {
            const Daylight sky = skyWith(covers[i], altitude, 40);
            EXPECT_NEAR(skyIlluminance(sky, up, 0) / sky.skyHorizontalIlluminance, 1,
                        isTabulated ? 0.002 : between[i])
                << covers[i];
        }
        const Daylight overcast = skyWith(1, altitude);
        EXPECT_NEAR(skyIlluminance(overcast, up, 0) / overcast.skyHorizontalIlluminance, 1.049, 0.001);
    }
}

/// The illuminance as a plain sum over directions, each asked for its luminance.
double plainIlluminance(const Daylight& sky, const float n[3], double north) {
    const double step = pi / 64;
    double sum = 0;
    for (int i = 0; i < 32; ++i) {
        const double weight = (std::cos(i * step) - std::cos((i + 1) * step)) * step;
        const double theta = (i + 0.5) * step;
        for (int j = 0; j < 128; ++j) {
            const double azimuth = (j + 0.5) * step - pi - north;
            const float d[3] = {static_cast<float>(-std::sin(azimuth) * std::sin(theta)),
                                static_cast<float>(-std::cos(azimuth) * std::sin(theta)),
                                static_cast<float>(std::cos(theta))};
            const double facing = d[0] * n[0] + d[1] * n[1] + d[2] * n[2];
            if (facing > 0) sum += skyLuminance(sky, d) * facing * weight;
        }
    }
    return sum;
}

TEST(Sky, IlluminanceIsTheSumOverItsDirections) {
    const float normals[][3] = {{0, 0, 1}, {0, 0, -1}, {1, 0, 0}, {0, -1, 0}, {0.6f, 0, 0.8f}, {0, 0.28f, -0.96f}};
    for (const float cover : covers)
        for (const double north : {0.0, 30.0, -135.0}) {
            const Daylight sky = skyWith(cover, 35, -50, north);
            for (const auto& n : normals) {
                const double plain = plainIlluminance(sky, n, inRadians(north));
                EXPECT_NEAR(skyIlluminance(sky, n, inRadians(north)), plain, 1e-6 * plain)
                    << cover << " " << north;
            }
        }
}

TEST(Sky, AnglesAndDirectionsAgree) {
    for (const float cover : covers) {
        const double north = 25;
        const Daylight sky = skyWith(cover, 50, 70, north);
        for (double theta = 0; theta <= 180; theta += 15)
            for (double azimuth = -180; azimuth <= 180; azimuth += 20) {
                const double t = inRadians(theta);
                const double a = inRadians(azimuth + north);
                const float d[3] = {static_cast<float>(-std::sin(a) * std::sin(t)),
                                    static_cast<float>(-std::cos(a) * std::sin(t)),
                                    theta == 90 ? 0 : static_cast<float>(std::cos(t))};
                const double luminance = skyLuminanceAt(sky, theta, azimuth);
                EXPECT_NEAR(skyLuminance(sky, d), luminance, 1e-4 * luminance);
                EXPECT_EQ(luminance > 0, theta < 90);
            }
        EXPECT_NEAR(skyLuminance(sky, up), sky.zenithLuminance, 1e-4 * sky.zenithLuminance);
        const float nowhere[3] = {NAN, 0, 1};
        EXPECT_EQ(skyLuminance(sky, nowhere) + skyIlluminance(sky, nowhere, 0), 0);
    }
}

TEST(Sky, NightIsDark) {
    for (const float cover : covers)
        for (const double altitude : {0.0, -0.1, -5.0, -90.0}) {
            const Daylight sky = skyWith(cover, altitude);
            EXPECT_EQ(sky.directNormalIlluminance, 0);
            EXPECT_FALSE(std::signbit(sky.directHorizontalIlluminance));
            EXPECT_EQ(sky.skyCoefficients, (std::array<float, 6>{}));
            EXPECT_EQ(skyIlluminance(sky, up, 0) + skyLuminance(sky, up), 0);
        }
    EXPECT_EQ(skyWith(0, -0.1).skyHorizontalIlluminance, 0);
    EXPECT_NEAR(skyWith(0.5f, -0.1).skyHorizontalIlluminance, 300 - 45000 * std::sin(inRadians(0.1)), 1e-3);
    EXPECT_EQ(skyWith(1, -5).skyHorizontalIlluminance, 0);
}

TEST(Sky, ValuesOfTheModel) {
    // Worked out apart, from the model's formulas: 21 June, the sun 30 degrees high.
    const struct {
        float direct, horizontal, zenith;
        std::array<float, 6> coefficients;
    } cases[] = {
        {80990.858f, 11760.155f, 1837.9965f, {4613.9737f, 0, 1724.8773f, 8084.6657f, 5798.2757f, 2987.7877f}},
        {24886.77f, 22800, 5247.1477f, {6087.0421f, 0, 6283.1855f, 15021.51f, 11350, 4959.1901f}},
        {0, 10800, 4417.2001f, {6419.3927f, 1481.5528f, 4250.0001f, 0, 5350.0001f, 0}}};
    for (int i = 0; i < 3; ++i) {
        const Daylight sky = skyWith(covers[i], 30);
        EXPECT_FLOAT_EQ(sky.directNormalIlluminance, cases[i].direct);
        EXPECT_FLOAT_EQ(sky.skyHorizontalIlluminance, cases[i].horizontal);
        EXPECT_FLOAT_EQ(sky.zenithLuminance, cases[i].zenith);
        for (std::size_t k = 0; k < 6; ++k)
            EXPECT_FLOAT_EQ(sky.skyCoefficients[k], cases[i].coefficients[k]) << covers[i] << " " << k;
    }
    const float shares[] = {0.263f, 0.655f, 0.082f};  // of red, green and blue in a luminance
    for (std::size_t k = 0; k < 3; ++k) {
        Ov::NaturalLightSettings settings{.sunColor = {}};
        settings.sunColor[k] = 2;
        EXPECT_FLOAT_EQ(computeDaylight(settings, {}).sunColor[k], 1 / shares[k]);
    }
}

TEST(Sky, CoverChoosesTheKind) {
    EXPECT_EQ(skyWith(std::nextafter(0.35f, 0.0f), 60).skyType, SkyType::clear);
    EXPECT_EQ(skyWith(0.35f, 60).skyType, SkyType::partlyCloudy);
    EXPECT_EQ(skyWith(0.75f, 60).skyType, SkyType::partlyCloudy);
    const Daylight overcast = skyWith(std::nextafter(0.75f, 1.0f), 60);
    EXPECT_EQ(overcast.skyType, SkyType::overcast);
    EXPECT_EQ(overcast.directNormalIlluminance, 0);
}

class Light : public Photo {
protected:
    Ov::NaturalLightSettings settings() const {
        Ov::NaturalLightSettings all;
        light->getSettings(all);
        return all;
    }

    RnRef<DaylightData> light = Ov::rnCreate<DaylightData>();
};

TEST_F(Light, NewObjectsHaveTheDefaultsInDegrees) {
    light = RnRef<DaylightData>::share(dynamic_cast<DaylightData*>(immortal<DaylightBuilder>().create().get()));
    EXPECT_EQ(light->getLatitude(), 41);
    EXPECT_EQ(light->getLongitude(), 74);
    EXPECT_EQ(light->getTimeZone(), 75);
    EXPECT_EQ(light->getTimeZoneHours(), 5);
    EXPECT_EQ(light->getMonth(), 6);
    EXPECT_EQ(light->getDayOfMonth(), 21);
    EXPECT_EQ(light->getLocalTime(), 10);
    EXPECT_NEAR(light->getSolarTime(), 9.0 + light->getEquationOfTime() + 4.0 / 60, 1e-6);
    EXPECT_EQ(light->getMaxDirectNormalIlluminance(), 131835.0f);
    light->setSolarTime(7);
    light->setLatitude(-10);
    light->reset();
    EXPECT_EQ(settings(), Ov::NaturalLightSettings());
    EXPECT_NEAR(light->getSolarTime(), 9.0 + light->getEquationOfTime() + 4.0 / 60, 1e-6);
}

TEST_F(Light, SettersInvalidateWhatDependsOnThem) {
    using L = DaylightData;
    const float color[3] = {1, 2, 3};
    const auto check = [&](bool invalidates, const auto& set) {
        light->getSunrise();
        ASSERT_TRUE(light->isUpToDate());
        const Ov::NaturalLightSettings before = settings();
        set();
        const Ov::NaturalLightSettings after = settings();
        light->getLocalTime();  // getters of settings do not compute
        EXPECT_EQ(light->isUpToDate(), !invalidates);
        EXPECT_TRUE(invalidates || after != before);
    };
    for (const auto set : {&L::setLatitude, &L::setLongitude, &L::setNorth, &L::setTimeZoneHours, &L::setTimeZone,
                           &L::setLocalTime, &L::setSolarTime, &L::setSkyCover, &L::setSkyShadowAccuracy})
        check(true, [&] { (light.get()->*set)(1); });
    for (const auto set : {&L::setSunColor, &L::setSkyColor}) check(true, [&] { (light.get()->*set)(color); });
    check(true, [&] { light->setDayOfYear(1); });
    check(true, [&] { light->setDate(1, 1); });
    check(true, [&] { light->setSettings(settings()); });
    check(true, [&] { light->reset(); });
    for (const auto set :
         {&L::setEnabled, &L::setSunCastsShadows, &L::setSunFlag2, &L::setSunFlag3, &L::setSkyFlag2})
        check(false, [&] { (light.get()->*set)(false); });
    for (const auto set : {&L::setOutside, &L::setSkyCastsShadows, &L::setSkyFlag3})
        check(false, [&] { (light.get()->*set)(true); });
    check(false, [&] { light->setSolarPosition(1, 1); });
    check(false, [&] { light->setDirectNormalIlluminance(1); });
    for (const auto set : {&L::setDaylightSaving, &L::setOverrideSolarPosition, &L::setOverrideSolarIlluminance})
        check(true, [&] { (light.get()->*set)(true); });
    check(true, [&] { light->setSolarPosition(0.5f, 0.2f); });
    check(true, [&] { light->setDirectNormalIlluminance(7); });
    EXPECT_EQ(light->getSolarAltitude(), 0.5f);
    EXPECT_EQ(light->getSolarAzimuth(), 0.2f);
    EXPECT_FLOAT_EQ(light->getSolarZenith(), halfPi - 0.5f);
    EXPECT_EQ(light->getDirectNormalIlluminance(), 7);
    EXPECT_FLOAT_EQ(light->getDirectHorizontalIlluminance(), 7 * std::sin(0.5f));
}

TEST_F(Light, SolarTimeIsTheInputUntilALocalTimeIs) {
    light->setSolarTime(12);
    EXPECT_EQ(light->getLocalTime(), 10);
    EXPECT_EQ(light->getSolarTime(), 12);
    EXPECT_EQ(light->getLocalTime(), light->getSolarNoon());
    EXPECT_NEAR(light->getSolarAzimuth(), 0, 1e-6);
    const auto copy = light->clone();
    copy->setLongitude(60);
    EXPECT_EQ(copy->getSolarTime(), 12);
    EXPECT_NEAR(copy->getLocalTime(), light->getLocalTime() - 14.0 / 15, 1e-5);
    const float noon = light->getLocalTime();
    light->setLocalTime(noon + 1);
    EXPECT_FLOAT_EQ(light->getSolarTime(), 13);
    EXPECT_EQ(light->getLocalTime(), noon + 1);
    light->setSolarTime(3);
    light->setSettings(settings());
    EXPECT_FLOAT_EQ(light->getSolarTime(), 13);
}

TEST_F(Light, SunriseIsWhenTheSunIsAtTheHorizon) {
    for (const Site& site : sites) {
        light->setSettings(settingsOf(site, 60));
        light->setDaylightSaving(true);
        light->setLocalTime(light->getSunset());
        EXPECT_NEAR(light->getSolarAltitude(), 0, 1e-5) << site.name;
        EXPECT_NEAR(light->getSunsetSolarTime(), light->getSolarTime(), 1e-5);
        EXPECT_NEAR(light->getSunriseSolarTime() + light->getSunsetSolarTime(), 24, 1e-5);
    }
}

TEST_F(Light, SettingsOutOfRangeAreLimitedInTheComputationAlone) {
    const struct {
        void (DaylightData::*set)(float);
        float given, like;
    } cases[] = {
        {&DaylightData::setLatitude, 95, 90},       {&DaylightData::setLatitude, -1e30f, -90},
        {&DaylightData::setLongitude, 180, -180},   {&DaylightData::setLongitude, -300, -180},
        {&DaylightData::setTimeZoneHours, 13, -12}, {&DaylightData::setSkyCover, 7, 1},
        {&DaylightData::setSkyCover, -7, 0},
    };
    for (const auto& c : cases) {
        const auto other = Ov::rnCreate<DaylightData>();
        light->reset();
        (light.get()->*c.set)(c.given);
        (other.get()->*c.set)(c.like);
        EXPECT_EQ(light->getSunDirection(), other->getSunDirection()) << c.given;
        EXPECT_EQ(light->getSunrise(), other->getSunrise()) << c.given;
        EXPECT_EQ(light->getZenithLuminance(), other->getZenithLuminance()) << c.given;
    }
    light->setLatitude(95);
    for (const auto& [given, like] : {std::pair(0, 1), std::pair(366, 365), std::pair(65535, 1)}) {
        light->setDayOfYear(static_cast<std::uint16_t>(given));
        EXPECT_EQ(light->getEquationOfTime(), static_cast<float>(equationOfTime(like)));
        EXPECT_EQ(light->getDayOfYear(), given);
        EXPECT_EQ(light->getMonth() + light->getDayOfMonth(), 0);
    }
    EXPECT_EQ(light->getLatitude(), 95);
    light->setDate(2, 29);
    EXPECT_EQ(light->getDayOfYear(), 0);
}

TEST_F(Light, NothingIsEverNotANumber) {
    for (const float value : {NAN, INFINITY, -INFINITY, 1e30f, -2.0f, 2.0f, 4.0f, halfPi, 0.0f})
        for (const float cover : {0.0f, 0.5f, 1.0f, value})
            for (const bool isOverridden : {false, true}) {
                Ov::NaturalLightSettings in;
                in.latitude = in.longitude = in.timeZone = in.localTime = in.north = value;
                in.sunColor = {value, value, value};
                in.solarAltitude = in.solarAzimuth = in.directNormalIlluminance = value;
                in.skyCover = cover;
                in.overrideSolarPosition = in.overrideSolarIlluminance = isOverridden;
                const Daylight d = computeDaylight(in, isOverridden ? std::optional(value) : std::nullopt);
                double sum = d.sunrise + d.sunset + d.solarNoon + d.solarAltitude + d.solarAzimuth +
                             d.directHorizontalIlluminance + d.skyHorizontalIlluminance + d.zenithLuminance +
                             skyIlluminance(d, up, in.north) + skyLuminance(d, up);
                for (const float c : d.skyCoefficients) sum += c;
                for (std::size_t i = 0; i < 3; ++i) sum += d.sunDirection[i] + d.sunColor[i];
                EXPECT_FALSE(std::isnan(sum)) << value << " " << cover << " " << isOverridden;
            }
}

constexpr float infinity = std::numeric_limits<float>::infinity();
constexpr float notANumber = std::numeric_limits<float>::quiet_NaN();
constexpr float degree = 3.1415927F / 180;

TEST(Calendar, EveryDayOfTheYearIsOneDate) {
    int month = 0, day = 0, lastMonth = 1, lastDay = 0;
    for (int yearDay = 1; yearDay <= 365; ++yearDay) {
        ASSERT_TRUE(monthAndDay(yearDay, &month, &day));
        EXPECT_EQ(dayOfYear(month, day), yearDay);
        const bool newMonth = lastDay == getDaysInMonth(lastMonth);
        EXPECT_EQ(month, newMonth ? lastMonth + 1 : lastMonth) << yearDay;
        EXPECT_EQ(day, newMonth ? 1 : lastDay + 1) << yearDay;
        lastMonth = month;
        lastDay = day;
    }
    EXPECT_EQ(lastMonth, 12);
    EXPECT_EQ(lastDay, 31);
    EXPECT_EQ(dayOfYear(6, 21), 172);
    EXPECT_TRUE(monthAndDay(59, nullptr, &day));
    EXPECT_TRUE(monthAndDay(60, &month, nullptr));
    EXPECT_EQ(day, 28);
    EXPECT_EQ(month, 3);
}

TEST(Calendar, WhatIsNoDateGivesNothing) {
    for (int month : {INT_MIN, -1, 0, 13, INT_MAX}) {
        EXPECT_EQ(dayOfYear(month, 1), 0) << month;
        EXPECT_EQ(getDaysInMonth(month), 0) << month;
        EXPECT_STREQ(getMonthName(month), L"");
        EXPECT_STREQ(getMonthShortName(month), L"");
    }
    for (int day : {INT_MIN, -1, 0, 29, INT_MAX}) EXPECT_EQ(dayOfYear(2, day), 0) << day;
    for (int yearDay : {INT_MIN, -1, 0, 366, INT_MAX}) {
        int month = -7, day = -8;
        EXPECT_FALSE(monthAndDay(yearDay, &month, &day));
        EXPECT_EQ(month, -7);
        EXPECT_EQ(day, -8);
    }
}

/// A reading of the clock as "13:45", with " pm" where that is told.
std::string reading(bool twelveHour, float decimal) {
    int hours = -1, minutes = -1;
    bool pm = false;
    decimalToHoursMinutes(twelveHour, decimal, &hours, &minutes, &pm);
    return std::to_string(hours) + ":" + std::to_string(minutes) + (pm ? " pm" : "");
}

TEST(Clock, EveryMinuteComesBack) {
    for (int minute = 0; minute < 24 * 60; ++minute)
        for (bool twelveHour : {false, true}) {
            const bool pm = twelveHour && minute >= 12 * 60;
            const int hours = minute / 60 - (pm ? 12 : 0);
            EXPECT_EQ(reading(twelveHour, static_cast<float>(minute) / 60),
                      std::to_string(hours) + ":" + std::to_string(minute % 60) + (pm ? " pm" : ""));
            EXPECT_NEAR(hoursMinutesToDecimal(twelveHour, hours, minute % 60, pm), minute / 60.0, 2e-6);
        }
}

TEST(Clock, ReadsAnyHours) {
    const struct {
        float decimal;
        const char* of24;
        const char* of12;
    } cases[] = {
        {13.75F, "13:45", "1:45 pm"}, {-0.5F, "23:30", "11:30 pm"}, {0.25F, "0:15", "0:15"},
        {12, "12:0", "0:0 pm"},       {23.992F, "0:0", "0:0"},      {-0.001F, "0:0", "0:0"},
        {-24, "0:0", "0:0"},          {49.5F, "1:30", "1:30"},      {notANumber, "0:0", "0:0"},
        {infinity, "0:0", "0:0"},     {-infinity, "0:0", "0:0"},    {3e38F, "0:0", "0:0"},
        {0.0083F, "0:0", "0:0"},      {0.0084F, "0:1", "0:1"},      {16777216, "16:0", "4:0 pm"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(reading(false, c.decimal), c.of24) << c.decimal;
        EXPECT_EQ(reading(true, c.decimal), c.of12) << c.decimal;
    }
    bool pm = true;
    decimalToHoursMinutes(false, 1, nullptr, nullptr, &pm);
    EXPECT_TRUE(pm);  // not for a clock of 24 hours
    decimalToHoursMinutes(true, 1, nullptr, nullptr, nullptr);
}

TEST(Clock, TakesAnyReading) {
    EXPECT_EQ(hoursMinutesToDecimal(true, 12, 30, false), 0.5F);
    EXPECT_EQ(hoursMinutesToDecimal(true, 12, 30, true), 12.5F);
    EXPECT_EQ(hoursMinutesToDecimal(false, 23, 60, false), 0);
    EXPECT_EQ(hoursMinutesToDecimal(false, 0, 60 * 50, true), 26);  // taken off once
    EXPECT_EQ(hoursMinutesToDecimal(false, -25, 0, false), -1);
    EXPECT_EQ(hoursMinutesToDecimal(true, -13, 0, true), 11);
    EXPECT_EQ(hoursMinutesToDecimal(false, 1, -30, false), 0.5F);
    EXPECT_FLOAT_EQ(hoursMinutesToDecimal(false, INT_MIN, INT_MIN, false), -35791396.0F);
    EXPECT_FLOAT_EQ(hoursMinutesToDecimal(true, INT_MAX, INT_MAX, true), 35791396.0F);
}

TEST(TimeZones, EveryMeridianFindsTheFirstZoneOfItsOffset) {
    ASSERT_EQ(getTimeZoneCount(), 31);
    for (int i = 0; i < getTimeZoneCount(); ++i) {
        const int found = findTimeZone(getTimeZoneMeridian(i));
        EXPECT_EQ(getTimeZoneMeridian(found), getTimeZoneMeridian(i));
        EXPECT_EQ(getTimeZoneFlag(i), found == i ? 0 : 1) << i;
        EXPECT_LE(found, i);
    }
    EXPECT_FLOAT_EQ(getTimeZoneMeridian(2), 75 * degree);
    EXPECT_EQ(findTimeZone(75 * degree), 2);
    EXPECT_EQ(findTimeZone(-120 * degree), 14);
    EXPECT_EQ(findTimeZone(56.25F * degree), 0);  // as far from 3.5 as from 4
    EXPECT_EQ(findTimeZone(static_cast<float>(-10.5 * std::numbers::pi / 12)), 10);
    EXPECT_EQ(findTimeZone(static_cast<float>(-7.25 * std::numbers::pi / 12)), 16);
    EXPECT_EQ(findTimeZone(1000), 8);
    EXPECT_EQ(findTimeZone(-1000), 9);
    for (float meridian : {infinity, -infinity, notANumber}) EXPECT_EQ(findTimeZone(meridian), 0);
}

TEST(TimeZones, HoldTheirMeridiansAndExcludeTheirBounds) {
    for (int i = 1; i < getTimeZoneCount(); ++i)
        EXPECT_TRUE(isInTimeZone(i, getTimeZoneMeridian(i) / degree)) << i;
    const struct {
        int zone;
        float longitude;
        bool inside;
    } cases[] = {
        {10, -170, true}, {10, 100, false}, {10, 175, false}, {10, 176, true},        {10, -135, false},
        {10, -136, true}, {8, 180, true},   {8, -164, false}, {2, 45, false},         {2, 104, true},
        {2, 105, false},  {11, -179, true}, {11, 180, false}, {2, notANumber, false}, {10, infinity, false},
    };
    for (const auto& c : cases)
        EXPECT_EQ(isInTimeZone(c.zone, c.longitude), c.inside) << c.zone << " " << c.longitude;
    for (int index : {INT_MIN, -1, 31, INT_MAX}) {
        EXPECT_FALSE(isInTimeZone(index, 0));
        EXPECT_EQ(getTimeZoneFlag(index), 0);
        EXPECT_EQ(getTimeZoneMeridian(index), 0);
        EXPECT_STREQ(getTimeZoneName(index), L"");
    }
}

TEST(CalendarNames, AreMessagesOfTheirNumbers) {
    MessageLog log;
    std::set<std::wstring> names;
    for (int month = 1; month <= 12; ++month) {
        names.insert(getMonthName(month));
        names.insert(getMonthShortName(month));
    }
    for (int i = 0; i < getTimeZoneCount(); ++i) names.insert(getTimeZoneName(i));
    EXPECT_EQ(names.size(), 55U);
    EXPECT_EQ(*names.begin(), L"13026");
    EXPECT_EQ(*names.rbegin(), L"13080");
    EXPECT_STREQ(getMonthShortName(5), L"13080");
    EXPECT_STREQ(getTimeZoneName(10), L"13049");

    const wchar_t* march = getMonthName(3);
    getMonthShortName(4);
    getTimeZoneName(5);
    EXPECT_STREQ(march, L"13030");  // valid until the same function is called again

    Ov::messageFile().setFileName(L"/none/Res.dll");
    for (const auto name : {getMonthName, getMonthShortName, getTimeZoneName})
        EXPECT_THROW(name(1), Ov::RnMessageFileEx::ExNoCatalogue);
}

}  // namespace
}  // namespace OvPhotometrics
