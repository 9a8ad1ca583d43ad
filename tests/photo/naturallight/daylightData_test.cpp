#include "components/photo/naturallight/daylightData.h"

#include <functional>

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
    const float color[3] = {1, 2, 3};
    Ov::NaturalLightSettings all;
    const struct {
        const char* name;
        std::function<void()> set;
        bool invalidates;
    } cases[] = {
        {"settings", [&] { light->setSettings(all); }, true},
        {"reset", [&] { light->reset(); }, true},
        {"enabled", [&] { light->setEnabled(false); }, false},
        {"outside", [&] { light->setOutside(true); }, false},
        {"latitude", [&] { light->setLatitude(1); }, true},
        {"longitude", [&] { light->setLongitude(1); }, true},
        {"north", [&] { light->setNorth(1); }, true},
        {"day", [&] { light->setDayOfYear(1); }, true},
        {"date", [&] { light->setDate(1, 1); }, true},
        {"zone in hours", [&] { light->setTimeZoneHours(1); }, true},
        {"zone", [&] { light->setTimeZone(1); }, true},
        {"daylight saving", [&] { light->setDaylightSaving(false); }, true},
        {"local time", [&] { light->setLocalTime(1); }, true},
        {"solar time", [&] { light->setSolarTime(1); }, true},
        {"sky cover", [&] { light->setSkyCover(1); }, true},
        {"accuracy", [&] { light->setSkyShadowAccuracy(1); }, true},
        {"sun casts shadows", [&] { light->setSunCastsShadows(false); }, false},
        {"sun flag 2", [&] { light->setSunFlag2(false); }, false},
        {"sun flag 3", [&] { light->setSunFlag3(false); }, false},
        {"sky casts shadows", [&] { light->setSkyCastsShadows(true); }, false},
        {"sky flag 2", [&] { light->setSkyFlag2(false); }, false},
        {"sky flag 3", [&] { light->setSkyFlag3(true); }, false},
        {"sun color", [&] { light->setSunColor(color); }, true},
        {"sky color", [&] { light->setSkyColor(color); }, true},
        {"position, not overridden", [&] { light->setSolarPosition(1, 1); }, false},
        {"illuminance, not overridden", [&] { light->setDirectNormalIlluminance(1); }, false},
        {"override of the position", [&] { light->setOverrideSolarPosition(true); }, true},
        {"override of the illuminance", [&] { light->setOverrideSolarIlluminance(true); }, true},
        {"position", [&] { light->setSolarPosition(0.5f, 0.2f); }, true},
        {"illuminance", [&] { light->setDirectNormalIlluminance(7); }, true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        light->getSunrise();
        ASSERT_TRUE(light->isUpToDate());
        const Ov::NaturalLightSettings before = settings();
        c.set();
        EXPECT_EQ(light->isUpToDate(), !c.invalidates);
        EXPECT_TRUE(c.invalidates || settings() != before);
        light->getSettings(all);
        light->getLocalTime();
        EXPECT_EQ(light->isUpToDate(), !c.invalidates) << "getters of settings do not compute";
    }
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
        const char* name;
        std::function<void(DaylightData&)> set, like;
    } cases[] = {
        {"day 0", [](auto& d) { d.setDayOfYear(0); }, [](auto& d) { d.setDayOfYear(1); }},
        {"day 366", [](auto& d) { d.setDayOfYear(366); }, [](auto& d) { d.setDayOfYear(365); }},
        {"day -1", [](auto& d) { d.setDayOfYear(65535); }, [](auto& d) { d.setDayOfYear(1); }},
        {"no date", [](auto& d) { d.setDate(2, 29); }, [](auto& d) { d.setDayOfYear(1); }},
        {"latitude", [](auto& d) { d.setLatitude(95); }, [](auto& d) { d.setLatitude(90); }},
        {"south", [](auto& d) { d.setLatitude(-1e30f); }, [](auto& d) { d.setLatitude(-90); }},
        {"longitude", [](auto& d) { d.setLongitude(180); }, [](auto& d) { d.setLongitude(-180); }},
        {"far longitude", [](auto& d) { d.setLongitude(-300); }, [](auto& d) { d.setLongitude(-180); }},
        {"zone", [](auto& d) { d.setTimeZoneHours(13); }, [](auto& d) { d.setTimeZone(-180); }},
        {"cover", [](auto& d) { d.setSkyCover(7); }, [](auto& d) { d.setSkyCover(1); }},
    };
    for (const auto& c : cases) {
        const auto a = Ov::rnCreate<DaylightData>();
        const auto b = Ov::rnCreate<DaylightData>();
        c.set(*a);
        c.like(*b);
        EXPECT_EQ(a->getSolarTime(), b->getSolarTime()) << c.name;
        EXPECT_EQ(a->getSunDirection(), b->getSunDirection()) << c.name;
        EXPECT_EQ(a->getSunrise(), b->getSunrise()) << c.name;
        EXPECT_EQ(a->getZenithLuminance(), b->getZenithLuminance()) << c.name;
    }
    light->setLatitude(95);
    light->setDayOfYear(400);
    light->getSunrise();
    EXPECT_EQ(light->getLatitude(), 95);
    EXPECT_EQ(light->getDayOfYear(), 400);
    EXPECT_EQ(light->getMonth() + light->getDayOfMonth(), 0);
}

TEST_F(Light, NothingIsEverNotANumber) {
    const float odd[] = {NAN, INFINITY, -INFINITY, 1e30f, -2, 2, 4, halfPi, 0};
    for (const float value : odd)
        for (const float cover : {0.0f, 0.5f, 1.0f, value}) {
            Ov::NaturalLightSettings all;
            all.latitude = all.longitude = all.timeZone = all.localTime = all.north = value;
            all.sunColor = all.skyColor = {value, value, value};
            all.solarAltitude = all.solarAzimuth = all.directNormalIlluminance = value;
            all.skyCover = cover;
            for (const bool isOverridden : {false, true}) {
                all.overrideSolarPosition = all.overrideSolarIlluminance = isOverridden;
                const Daylight out = computeDaylight(all, isOverridden ? std::optional(value) : std::nullopt);
                double sum = out.equationOfTime + out.sunrise + out.sunset + out.solarNoon + out.solarAltitude +
                             out.solarAzimuth + out.solarZenith + out.directNormalIlluminance +
                             out.directHorizontalIlluminance + out.skyHorizontalIlluminance + out.zenithLuminance;
                for (const float c : out.skyCoefficients) sum += c;
                for (int i = 0; i < 3; ++i) sum += out.sunDirection[i] + out.sunColor[i] + out.skyColor[i];
                const float up[3] = {0, 0, 1};
                sum += skyIlluminance(out, up, all.north) + skyLuminance(out, up);
                EXPECT_FALSE(std::isnan(sum)) << value << " " << cover << " " << isOverridden;
            }
        }
}

}  // namespace
}  // namespace OvPhotometrics
