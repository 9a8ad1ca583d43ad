#include "components/photo/naturallight/daylightData.h"

#include "components/photo/naturallight/solar.h"
#include "tests/photo/naturallight/lightSupport.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

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
                const float up[3] = {0, 0, 1};
                double sum = d.sunrise + d.sunset + d.solarNoon + d.solarAltitude + d.solarAzimuth +
                             d.directHorizontalIlluminance + d.skyHorizontalIlluminance + d.zenithLuminance +
                             skyIlluminance(d, up, in.north) + skyLuminance(d, up);
                for (const float c : d.skyCoefficients) sum += c;
                for (std::size_t i = 0; i < 3; ++i) sum += d.sunDirection[i] + d.sunColor[i];
                EXPECT_FALSE(std::isnan(sum)) << value << " " << cover << " " << isOverridden;
            }
}

}  // namespace
}  // namespace OvPhotometrics
