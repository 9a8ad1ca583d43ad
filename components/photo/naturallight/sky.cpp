#include "components/photo/naturallight/sky.h"

#include <algorithm>
#include <cmath>
#include <numeric>

#include "components/photo/lid/angles.h"

namespace OvPhotometrics {

namespace {

// Zenith luminance over the mean luminance of the sky, every 5 degrees of solar altitude.
using RatioTable = std::array<double, 20>;
constexpr RatioTable clearRatios = {0.452, 0.44,  0.435, 0.436, 0.446, 0.464, 0.491, 0.53,  0.581, 0.648,
                                    0.734, 0.844, 0.985, 1.165, 1.398, 1.698, 2.086, 2.591, 3.248, 3.248};
constexpr RatioTable partlyCloudyRatios = {0.632, 0.636, 0.644, 0.656, 0.672, 0.694, 0.723, 0.758, 0.802, 0.854,
                                           0.916, 0.99,  1.076, 1.178, 1.296, 1.434, 1.595, 1.782, 2.002, 2.002};

// A power or root of a negative value counts as 0.
double root(double value) { return std::sqrt(std::max(value, 0.0)); }
double power(double value, double exponent) { return std::pow(std::max(value, 0.0), exponent); }

// A sky's luminance is the product of a gradation, which depends on the angle from the zenith alone, and an
// indicatrix, which depends on the angle from the sun alone.

struct ClearSky {
    static double gradation(double cosineOfZenith) { return 1 - std::exp(-0.32 / cosineOfZenith); }
    static double indicatrix(double angle, double cosine) {
        return 0.91 + 10 * std::exp(-3 * angle) + 0.45 * cosine * cosine;
    }
};

struct PartlyCloudySky {
    static double gradation(double cosineOfZenith) { return 1 - std::exp(-0.8 / cosineOfZenith); }
    static double indicatrix(double angle, double) { return 0.526 + 5 * std::exp(-1.5 * angle); }
};

template <class Sky>
double indicatrixAt(double cosineOfSun) {
    const double cosine = std::clamp(cosineOfSun, -1.0, 1.0);
    return Sky::indicatrix(std::acos(cosine), cosine);
}

/// The overcast sky is the same all around the zenith.
double overcastLuminance(const SkyCoefficients& c, double cosineOfZenith) {
    const double e = std::exp(-0.52 / cosineOfZenith);
    return c[0] * e + c[1] * (1 - e);
}

constexpr int bands = 32;
constexpr int azimuths = 128;
constexpr double step = exactPi / 64;  // of zenith angle and of azimuth

/// Sines and cosines of the sampled angles, `north` left out.
struct Samples {
    struct Terms {
        double sine, cosine;
    };
    struct Band : Terms {
        double weight;  // solid angle of one direction
    };
    std::array<Band, bands> zenith;
    std::array<Terms, azimuths> azimuth;

    Samples() {
        for (int i = 0; i < bands; ++i) {
            const double middle = i * step + exactPi / 128;
            const double weight = (std::cos(i * step) - std::cos((i + 1) * step)) * step;
            zenith[static_cast<std::size_t>(i)] = {{std::sin(middle), std::cos(middle)}, weight};
        }
        for (int j = 0; j < azimuths; ++j) {
            const double angle = (j + 0.5) * step - exactPi;
            azimuth[static_cast<std::size_t>(j)] = {std::sin(angle), std::cos(angle)};
        }
    }
};

const Samples& samples() {
    static const Samples instance;
    return instance;
}

/// `v` turned by `north`: the sun and the surface are turned instead of every sample.
Vector turned(const Vector& v, double north) {
    const double s = std::sin(north);
    const double c = std::cos(north);
    return {v[0] * c + v[1] * s, v[1] * c - v[0] * s, v[2]};
}

/// The product of a vector and a band's directions, as a function of the azimuth.
struct BandProduct {
    BandProduct(const Vector& v, const Samples::Band& band)
        : x(-v[0] * band.sine), y(-v[1] * band.sine), z(v[2] * band.cosine) {}
    double operator()(const Samples::Terms& azimuth) const { return x * azimuth.sine + y * azimuth.cosine + z; }
    double x, y, z;
};

using BandValues = std::array<double, azimuths>;

/// The cosines between a vector and a band's directions; 0 for those that it does not face.
BandValues facingOf(const Vector& v, const Samples::Band& band) {
    const BandProduct product(v, band);
    BandValues values;
    std::ranges::transform(samples().azimuth, values.begin(),
                           [&](const Samples::Terms& azimuth) { return std::max(0.0, product(azimuth)); });
    return values;
}

/// The indicatrix over the directions of a band that the surface faces, times the cosines `facing`. In loops of
/// one function each, which overlap in the processor as calls of two in turn do not.
template <class Sky>
double sumIndicatrix(const Vector& sun, const Samples::Band& band, const BandValues& facing) {
    const BandProduct toSun(sun, band);
    BandValues cosines;
    std::ranges::transform(samples().azimuth, cosines.begin(),
                           [&](const Samples::Terms& azimuth) { return std::clamp(toSun(azimuth), -1.0, 1.0); });
    BandValues angles;
    for (std::size_t j = 0; j < azimuths; ++j)
        if (facing[j] > 0) angles[j] = std::acos(cosines[j]);
    double sum = 0;
    for (std::size_t j = 0; j < azimuths; ++j)
        if (facing[j] > 0) sum += facing[j] * Sky::indicatrix(angles[j], cosines[j]);
    return sum;
}

/// Adds up all bands: `gradation` of a band times `sum` over its directions that the surface faces.
template <class Gradation, class Sum>
double sumBands(const Vector& normal, Gradation gradation, Sum sum) {
    double total = 0;
    for (const Samples::Band& band : samples().zenith)
        total += gradation(band.cosine) * band.weight * sum(band, facingOf(normal, band));
    return total;
}

template <class Sky>
double sumSky(const Vector& sun, const Vector& normal) {
    return sumBands(normal, Sky::gradation, [&](const Samples::Band& band, const BandValues& facing) {
        return sumIndicatrix<Sky>(sun, band, facing);
    });
}

double sumOvercastSky(const SkyCoefficients& c, const Vector& normal) {
    return sumBands(
        normal, [&](double cosine) { return overcastLuminance(c, cosine); },
        [](const Samples::Band&, const BandValues& facing) {
            return std::accumulate(facing.begin(), facing.end(), 0.0);
        });
}

}  // namespace

SkyType skyTypeOf(float cover) {
    if (cover < 0.35f) return SkyType::clear;
    return cover <= 0.75f ? SkyType::partlyCloudy : SkyType::overcast;
}

double directNormalIlluminance(SkyType type, double altitude, int day) {
    if (!(altitude > 0) || type == SkyType::overcast) return 0;
    const double extinction = type == SkyType::clear ? 0.21 : 0.80;
    const double distance = 1 + 0.034 * std::cos(2 * exactPi * (day - 2) / 365);
    return solarIlluminance * distance * std::exp(-extinction / std::abs(std::sin(altitude)));
}

double skyHorizontalIlluminance(SkyType type, double altitude) {
    const double sine = std::sin(altitude);
    switch (type) {
        case SkyType::partlyCloudy:
            return std::max(45000 * sine + 300, 0.0);
        case SkyType::overcast:
            return std::max(21000 * sine + 300, 0.0);
        default:
            return altitude >= 0 ? 15500 * root(sine) + 800 : 0;
    }
}

double zenithLuminance(SkyType type, double altitude, double horizontal) {
    if (type == SkyType::overcast) return 0.409 * horizontal;
    const RatioTable& ratios = type == SkyType::clear ? clearRatios : partlyCloudyRatios;
    constexpr double spacing = exactPi / 36;
    const double a = std::clamp(altitude, 0.0, exactPi / 2);
    const auto below = std::min(static_cast<std::size_t>(a / spacing), ratios.size() - 2);
    const double part = a / spacing - static_cast<double>(below);
    return ((1 - part) * ratios[below] + part * ratios[below + 1]) / exactPi * horizontal;
}

SkyCoefficients skyCoefficients(SkyType type, double altitude, double zenithLuminance) {
    if (!(altitude > 0)) return {};
    const double fromZenith = exactPi / 2 - altitude;
    const double s = std::sin(altitude);
    const double c = std::cos(altitude);
    if (type == SkyType::clear) {
        const double zenith = ClearSky::indicatrix(fromZenith, std::max(0.0, s)) * ClearSky::gradation(1);
        return {zenithLuminance / zenith,
                0,
                4000 * power(altitude, 1.3),
                12000 * power(s, 0.3) * power(c, 1.3),
                8200 * root(s),
                6900 * s * c};
    }
    if (type == SkyType::partlyCloudy) {
        const double zenith = PartlyCloudySky::indicatrix(fromZenith, s) * PartlyCloudySky::gradation(1);
        return {zenithLuminance / zenith,  0,         12000 * altitude,
                30200 * power(s, 0.8) * c, 22700 * s, 14100 * power(s, 1.3) * c};
    }
    const double e = std::exp(-0.52);
    return {0.864 * zenithLuminance / e, 0.136 * zenithLuminance / (1 - e), 8500 * s, 0, 10700 * s, 0};
}

double skyLuminance(const SkyModel& sky, double cosineOfZenith, double cosineOfSun) {
    if (!(cosineOfZenith > 0) || std::isnan(cosineOfSun)) return 0;
    switch (sky.type) {
        case SkyType::clear:
            return sky.c[0] * indicatrixAt<ClearSky>(cosineOfSun) * ClearSky::gradation(cosineOfZenith);
        case SkyType::partlyCloudy:
            return sky.c[0] * indicatrixAt<PartlyCloudySky>(cosineOfSun) *
                   PartlyCloudySky::gradation(cosineOfZenith);
        default:
            return overcastLuminance(sky.c, cosineOfZenith);
    }
}

double skyIlluminance(const SkyModel& sky, const Vector& sun, const Vector& normal, double north) {
    const Vector s = turned(sun, north);
    const Vector n = turned(normal, north);
    switch (sky.type) {
        case SkyType::clear:
            return sky.c[0] * sumSky<ClearSky>(s, n);
        case SkyType::partlyCloudy:
            return sky.c[0] * sumSky<PartlyCloudySky>(s, n);
        default:
            return sumOvercastSky(sky.c, n);
    }
}

}  // namespace OvPhotometrics
