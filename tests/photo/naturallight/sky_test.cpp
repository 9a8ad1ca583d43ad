#include "components/photo/naturallight/sky.h"

#include <gtest/gtest.h>

#include "tests/photo/naturallight/lightSupport.h"

namespace OvPhotometrics {
namespace {

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

/// The luminance integrated over the upper hemisphere, 0.5 degree by 2 degrees.
double integral(const Daylight& sky) {
    double sum = 0;
    for (double theta = 0.25; theta < 90; theta += 0.5)
        for (double azimuth = -179; azimuth < 180; azimuth += 2)
            sum += skyLuminanceAt(sky, theta, azimuth) * std::sin(2 * inRadians(theta)) / 2;
    return sum * inRadians(0.5) * inRadians(2);
}

TEST(Sky, LuminanceAddsUpToTheHorizontalIlluminance) {
    const double between[] = {0.009, 0.003};  // clear, partly cloudy
    for (double altitude = 2.5; altitude <= 90; altitude += 2.5) {
        SCOPED_TRACE(altitude);
        const bool isTabulated = std::fmod(altitude, 5) == 0;
        for (int i = 0; i < 2; ++i) {
            const Daylight sky = skyWith(covers[i], altitude, 40);
            const double ratio = integral(sky) / sky.skyHorizontalIlluminance;
            EXPECT_NEAR(ratio, 1, isTabulated ? 0.002 : between[i]) << covers[i];
            EXPECT_NEAR(skyIlluminance(sky, up, 0) / sky.skyHorizontalIlluminance, ratio, 0.002);
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

TEST(Sky, HorizontalIlluminanceFollowsTheAltitude) {
    const struct {
        double altitude;
        float lux[3];  // clear, partly cloudy, overcast
    } cases[] = {{0, {800, 300, 300}}, {30, {11760.155f, 22800, 10800}}, {90, {16300, 45300, 21300}}};
    for (const auto& c : cases)
        for (int i = 0; i < 3; ++i)
            EXPECT_FLOAT_EQ(skyWith(covers[i], c.altitude).skyHorizontalIlluminance, c.lux[i]) << c.altitude;
}

TEST(Sky, ValuesOfTheModel) {
    // Worked out apart, from the model's formulas: 21 June, the sun 30 degrees high.
    const struct {
        float direct, zenith;
        std::array<float, 6> coefficients;
    } cases[] = {{80990.858f, 1837.9965f, {4613.9737f, 0, 1724.8773f, 8084.6657f, 5798.2757f, 2987.7877f}},
                 {24886.77f, 5247.1477f, {6087.0421f, 0, 6283.1855f, 15021.51f, 11350, 4959.1901f}},
                 {0, 4417.2001f, {6419.3927f, 1481.5528f, 4250.0001f, 0, 5350.0001f, 0}}};
    for (int i = 0; i < 3; ++i) {
        const Daylight sky = skyWith(covers[i], 30);
        EXPECT_FLOAT_EQ(sky.directNormalIlluminance, cases[i].direct);
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

}  // namespace
}  // namespace OvPhotometrics
