#include <bit>
#include <limits>
#include <random>

#include "components/photo/distributions/diffuse.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/distributions/web.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

float cosineOf(double degrees) { return static_cast<float>(std::cos(inRadians(degrees))); }

RnRef<Spotlight> makeSpotlight(double hotspot, double falloff, float candela) {
    const auto spot = Ov::rnCreate<Spotlight>();
    spot->setHotspotCosine(cosineOf(hotspot));
    spot->setFalloffCosine(cosineOf(falloff));
    spot->setPeakIntensity(candela);
    return spot;
}

class Distributions : public Photo {
protected:
    /// Lights of every kind; of webs, whole and part, turned and not.
    std::vector<RnRef<Ov::RnIntensityDist>> lights() {
        std::vector<RnRef<Ov::RnIntensityDist>> all = {Ov::rnCreate<Isotropic>(), Ov::rnCreate<Diffuse>(),
                                                       makeSpotlight(30, 60, 9), Ov::rnCreate<Web>()};
        for (const IesText& file : {IesText{.vertical = {0, 45, 90}},
                                    IesText{.horizontal = {90, 150, 270}, .values = "1 2 3 4 5 6 7 8 9"},
                                    IesText{.horizontal = {0, 90, 180, 360}},
                                    IesText{.type = 2, .vertical = {-90, 0, 90}, .horizontal = {-90, 0, 90}}})
            all.push_back(distributionOf(*import(file.text())));
        for (const auto& light : all) light->setFlux(1000);
        return all;
    }
};

TEST_F(Distributions, AnalyticLaws) {
    const auto lamp = Ov::rnCreate<Isotropic>();
    lamp->setFlux(1000);
    lamp->clone()->setPeakIntensity(1);
    const auto diffuse = Ov::rnCreate<Diffuse>();
    diffuse->setFlux(31.415927f);
    const auto spot = Ov::rnCreate<Spotlight>();
    spot->setPeakIntensity(100);
    const auto narrowCone = makeSpotlight(60, 30, 8);
    const struct {
        const Ov::RnIntensityDist& dist;
        double theta;
        double candela;
    } cases[] = {{*lamp, 0, 79.577469}, {*lamp, 130, 79.577469},      {*diffuse, 0, 10},   {*diffuse, 60, 5},
                 {*diffuse, 90, 0},     {*diffuse, 120, 0},           {*spot, 0, 100},     {*spot, 30, 50},
                 {*spot, 45, 18.8231},  {*spot, 59, 4.08695},         {*spot, 61, 0},      {*spot, 180, 0},
                 {*narrowCone, 0, 8},   {*narrowCone, 29.9, 6.93517}, {*narrowCone, 31, 0}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.theta);
        const GeVector3<float> unit = direction(c.theta, 50);
        const GeVector3<float> longer{7 * unit.x, 7 * unit.y, 7 * unit.z};
        for (const float candela : {c.dist.intensity(toRadians(c.theta), 2), c.dist.intensityAt(longer),
                                    c.dist.intensityAtUnit(unit), c.dist.localIntensity(toRadians(c.theta), 2),
                                    c.dist.localIntensityAt(longer), c.dist.localIntensityAtUnit(unit)})
            EXPECT_NEAR(candela, c.candela, 1e-6 + c.candela * 1e-5);
        EXPECT_EQ(c.dist.intensityAt({0, 0, 0}), &c.dist == lamp.get() ? lamp->candela : 0);
        EXPECT_THROW(c.dist.toLocalNormalized({0, 0, 0}), Ov::ExAssertion);
    }
    EXPECT_FLOAT_EQ(lamp->getFlux(), 1000);
    EXPECT_FLOAT_EQ(spot->getFlux(), 106.0671f);
    EXPECT_FLOAT_EQ(narrowCone->getThetaRange().last, toRadians(60));  // the wider angle
}

TEST_F(Distributions, ASpotlightUsesDoubleFunctionsRoundedOnce) {
    std::mt19937 random(3);
    const auto cosine = [&] { return std::uniform_real_distribution<float>(0.02f, 0.9999f)(random); };
    const auto rounded = [](double value) { return static_cast<float>(value); };
    for (int k = 0; k < 3000; ++k) {
        const auto spot = Ov::rnCreate<Spotlight>();
        const float hotspot = cosine(), falloff = cosine(), c = std::max(falloff, cosine());
        spot->setHotspotCosine(hotspot);
        spot->setFalloffCosine(falloff);
        spot->setPeakIntensity(1);
        const float exponent = rounded(std::log(0.5)) / rounded(std::log(double{hotspot}));
        EXPECT_EQ(spot->intensityAtUnit({0, 0, c}), rounded(std::pow(double{c}, double{exponent}))) << c;
        EXPECT_EQ(spot->getThetaRange().last, rounded(std::acos(double{std::min(hotspot, falloff)})));
        EXPECT_EQ(spot->getFlux(), rounded(6.283185307179586 / (double{exponent} + 1)) *
                                       (1 - rounded(std::pow(double{falloff}, double{exponent + 1}))));
    }
}

TEST_F(Distributions, SpotlightCosinesStayInTheirLimits) {
    constexpr float nan = std::numeric_limits<float>::quiet_NaN();
    const struct {
        float cosine, hotspot, falloff;
    } cases[] = {{0, 0.01745328f, 0}, {-0.3f, 0.01745328f, 0}, {nan, 0.01745328f, 0},
                 {0.5f, 0.5f, 0.5f},  {1, 1, 0.99999845f},     {1.5f, 1.5f, 0.99999845f}};
    for (const auto& c : cases) {
        const auto spot = Ov::rnCreate<Spotlight>();
        spot->setHotspotCosine(c.cosine);
        spot->setFalloffCosine(c.cosine);
        EXPECT_EQ(spot->getHotspotCosine(), c.hotspot);
        EXPECT_EQ(spot->getFalloffCosine(), c.falloff);
        spot->setFlux(100);
        const bool lit = c.hotspot <= 0.99999845f;
        EXPECT_EQ(spot->intensity(0, 0) > 0, lit) << c.cosine;
        EXPECT_FLOAT_EQ(spot->getFlux(), lit ? 100.0f : 0.0f);
    }
    const auto loaded = Ov::rnCreate<Spotlight>();
    load(*loaded, "5 1 0");  // loaded cosines have none: dark
    EXPECT_EQ(loaded->getHotspotCosine(), 1);
    EXPECT_EQ(loaded->intensity(0, 0) + loaded->getFlux(), 0);
}

TEST_F(Distributions, AWebGivesItsCandelas) {
    const auto web = import(IesText{.lumens = 1000, .vertical = {0, 45, 90}, .values = "200 500 100"}.text());
    const auto light = Ov::rnCreate<Web>();
    EXPECT_EQ(light->intensity(0, 0), 0);
    light->setWeb(web.get());
    light->setFlux(1000);
    EXPECT_EQ(light->getPeakIntensity(), 500);
    EXPECT_EQ(light->getFlux(), 1000);
    EXPECT_FLOAT_EQ(light->localIntensity(toRadians(45), 1), 500);
    EXPECT_FLOAT_EQ(light->intensityAt({0, 0, 7}), 200);
    EXPECT_EQ(light->intensityAt({1, 0, -0.1f}), 0);
    EXPECT_EQ(light->intensityAtUnit({0, 0, -1}), 0);
    EXPECT_THROW(light->intensityAt({0, 0, 0}), Ov::ExAssertion);
    EXPECT_THROW(light->localIntensityAt({0, 0, 0}), Ov::ExAssertion);
    EXPECT_EQ(light->intensity(std::nanf(""), 0), 0);

    light->setWeb(nullptr);
    EXPECT_EQ(light->getPeakIntensity(), 500);
    EXPECT_EQ(light->getFlux() + light->intensity(1, 1), 0);
    EXPECT_EQ(light->getSymmetry(), PhotoWebSymmetry::Axial);
    EXPECT_EQ(light->getPsiRange().last, 0);
    light->setWeb(&immortal<IsotropicBuilder>());  // no web
    EXPECT_EQ(light->getWeb(), nullptr);
}

TEST_F(Distributions, OneWebIsShared) {
    const auto web = import(IesText{.horizontal = {90, 180, 270}}.text());
    const auto holders = [&] {
        web->newReference();
        return web->release();
    };
    const long alone = holders();
    {
        const auto light = makeWebDistribution(*web);
        const auto clone = light->clone();
        EXPECT_EQ(holders(), alone + 2);
        EXPECT_EQ(clone->intensity(1, 2), light->intensity(1, 2));
        // The host frame is turned; in the distribution's own it is the web.
        const GeVector3<float> host = direction(60, 200);
        EXPECT_EQ(light->intensityAtUnit(host), light->localIntensityAtUnit(light->toLocal(host)));
    }
    EXPECT_EQ(holders(), alone);
}

TEST_F(Distributions, AnyLengthHasTheDirectionOfItsUnitVector) {
    const GeVector3<float> directions[] = {{0, 0, 1}, {3, -2, 7}, {1, 1, 1}, {-7, 5, -3}, {0, 1, 0}};
    for (const auto& light : lights())
        for (const GeVector3<float>& d : directions)
            for (int power = -149; power < 126; ++power) {
                SCOPED_TRACE(testing::Message() << d.x << " 2^" << power);
                const float scale = std::ldexp(1.0f, power);
                const GeVector3<float> scaled{d.x * scale, d.y * scale, d.z * scale};
                ASSERT_EQ(light->intensityAt(scaled), light->intensityAt(d));
                ASSERT_EQ(light->localIntensityAt(scaled), light->localIntensityAt(d));
                ASSERT_EQ(light->toLocalNormalized(scaled), light->toLocalNormalized(d));
                float candela = -1;
                getIntensities(light.get(), DirectionForm::vectors, &scaled.x, 1, &candela);
                ASSERT_EQ(candela, light->intensityAt(d));
            }
}

TEST_F(Distributions, LightIsFiniteAndNeverNegative) {
    constexpr float inf = std::numeric_limits<float>::infinity(), nan = std::numeric_limits<float>::quiet_NaN();
    const float numbers[] = {0, 1e-45f, 1e-38f, 1e-30f, 1e-6f, 1, 1e6f, 1e30f, 3e38f};
    const float angles[] = {0, 0.3f, 1, 2, 2.5f, 3};
    auto lights = this->lights();
    lights.push_back(makeSpotlight(1, 80, 1));
    for (const float lumens : numbers)
        for (const float peak : numbers)
            for (const float valley : {0.0f, -peak, -3e38f}) {
                PhotoWebRecord rec;
                photoWebRecordInit(rec, 3, 1, PhotoWebSymmetry::Axial, false, true, nullptr);
                photoWebRecordSetLumens(rec, lumens);
                for (const int i : {0, 1, 2}) {
                    rec.thetas[static_cast<std::size_t>(i)] = static_cast<float>(i);
                    photoWebRecordSetCandela(rec, i, 0, i == 1 ? valley : peak);
                }
                const auto web = Ov::rnCreate<PhotoWebIES>();
                if (!photoWebInstall(*web, rec)) continue;
                lights.push_back(makeWebDistribution(*web));
                const float flux = lights.back()->getFlux();
                EXPECT_TRUE(std::isfinite(flux) && (flux > 0 || !(web->getLumens() > 0))) << lumens << " " << peak;
                for (const float theta : angles) {
                    const float candela = lights.back()->intensity(theta, 1);
                    EXPECT_TRUE(candela >= 0 && std::isfinite(candela)) << lumens << " " << peak << " " << theta;
                }
            }
    EXPECT_GT(lights.size(), 100U);
    // Whatever a host sets, the answer is a number.
    const auto isNumber = [&](Ov::RnIntensityDist& light) {
        for (const float theta : angles) {
            const float direction[] = {theta, 1};
            float candela = nan;
            getIntensities(&light, DirectionForm::angles, direction, 1, &candela);
            if (std::isnan(candela) || std::isnan(light.intensity(theta, 1))) return false;
        }
        return !std::isnan(light.getFlux());
    };
    for (const auto& light : lights)
        for (const float number : {0.0f, 1e-45f, 3e38f, inf, -inf, nan}) {
            light->setFlux(number);
            EXPECT_TRUE(isNumber(*light)) << number;
            light->setPeakIntensity(number);
            EXPECT_TRUE(isNumber(*light)) << number;
        }
}

/// A web that the module does not know as one of its own.
class Stripes final : public Ov::RnCastHeap<Ov::RnCastImpl<RnBasePhotoWebData, Ov::RnPhotoWebData>> {
public:
    RnRef<Ov::RnPhotoWebData> clone() const override { return {}; }
    float getIntensity(float theta, float) const override { return std::fmod(theta, 0.2f); }
};

TEST_F(Distributions, ManyIntensitiesAreTheSingleOnes) {
    using Light = Ov::RnIntensityDist;
    using Vector = GeVector3<float>;
    constexpr float inf = std::numeric_limits<float>::infinity();
    const auto stripes = Ov::rnCreate<Stripes>();
    PhotoWebRecord rec;
    photoWebRecordInit(rec, 2, 1, PhotoWebSymmetry::Axial, false, true, nullptr);
    rec.thetas[0] = 0, rec.thetas[1] = 3;
    for (int i : {0, 1}) photoWebRecordSetCandela(rec, i, 0, 5);
    ASSERT_TRUE(photoWebInstall(*stripes, rec));
    const auto upsideDown = makeWebDistribution(*import(IesText{.horizontal = {90, 180, 270}}.text()));
    upsideDown->setPeakIntensity(-3);  // dark is 0, not -0, where the web does not reach
    auto lights = this->lights();
    lights.insert(lights.end(), {makeWebDistribution(*stripes), upsideDown});

    const float marks[] = {0,          -0.0f,  1,     -1,  0.6f, 1.57079633f,
                           3.1415927f, 1e-30f, 1e30f, inf, -inf, std::nanf("")};
    std::vector<DirectionAngles> pairs;
    std::vector<Vector> triples;
    for (const float a : marks)
        for (const float b : marks) {
            pairs.push_back({a, b});
            for (const float c : marks) triples.push_back({a, b, c});
        }
    std::mt19937 random(5);
    std::normal_distribution<float> normal;
    for (int k = 0; k < 999; ++k) {
        pairs.push_back({3 * normal(random), 3 * normal(random)});
        triples.push_back(Vector{normal(random), normal(random), normal(random)}.normalized());
    }

    for (const RnRef<Light>& light : lights) {
        const auto compare = [&](const char* what, auto ask, const auto& directions, auto single) {
            SCOPED_TRACE(testing::Message() << &light - lights.data() << what);
            std::remove_cvref_t<decltype(directions)> accepted;
            std::vector<float> expected;
            for (const auto& d : directions) {
                float candela = 7;
                try {
                    expected.push_back(single(d));
                    accepted.push_back(d);
                } catch (const Ov::ExAssertion&) {
                    EXPECT_THROW(ask(light.get(), {&d, 1}, {&candela, 1}), Ov::ExAssertion);
                }
            }
            std::vector<float> candela(expected.size(), 7);
            EXPECT_TRUE(ask(light.get(), accepted, candela));
            for (std::size_t k = 0; k < expected.size(); ++k)
                ASSERT_EQ(std::bit_cast<std::uint32_t>(candela[k]), std::bit_cast<std::uint32_t>(expected[k]))
                    << k;
        };
        compare(" angles", intensities, pairs, [&](auto d) { return light->intensity(d.theta, d.psi); });
        compare(" vectors", intensitiesAt, triples, [&](auto d) { return light->intensityAt(d); });
        compare(" units", intensitiesAtUnit, triples, [&](auto d) { return light->intensityAtUnit(d); });
        compare(" local angles", localIntensities, pairs,
                [&](auto d) { return light->localIntensity(d.theta, d.psi); });
        compare(" local vectors", localIntensitiesAt, triples, [&](auto d) { return light->localIntensityAt(d); });
        compare(" local units", localIntensitiesAtUnit, triples,
                [&](auto d) { return light->localIntensityAtUnit(d); });
    }
}

TEST_F(Distributions, WhatCannotBeAnsweredIsRefused) {
    const auto light = makeWebDistribution(*import(IesText{}.text()));
    const float up[3] = {0, 0, 1};
    float candela = 7;
    const struct {
        Ov::RnCastable* light;
        int form;
        const float* directions;
        int count;
        float* candela;
        bool answered;
    } cases[] = {{light.get(), 1, up, 1, &candela, true},      {light.get(), 1, nullptr, 0, nullptr, true},
                 {light.get(), 1, up, 0, &candela, true},      {nullptr, 1, up, 1, &candela, false},
                 {light->getWeb(), 1, up, 1, &candela, false}, {light.get(), 1, nullptr, 1, &candela, false},
                 {light.get(), 1, up, 1, nullptr, false},      {light.get(), 1, up, -1, &candela, false},
                 {light.get(), 6, up, 1, &candela, false},     {light.get(), -1, up, 1, &candela, false}};
    for (const auto& c : cases) {
        SCOPED_TRACE(&c - cases);
        candela = 7;
        EXPECT_EQ(getIntensities(c.light, static_cast<DirectionForm>(c.form), c.directions, c.count, c.candela),
                  c.answered);
        EXPECT_EQ(candela, c.answered && c.count ? light->intensityAt({0, 0, 1}) : 7);
    }
    const DirectionAngles two[2];
    EXPECT_FALSE(intensities(light.get(), two, {&candela, 1}));
}

TEST_F(Distributions, OnlyAWebIsLoadedAsTheWebOfOne) {
    for (const Form form : {Form::text, Form::binary}) {
        const auto device = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(device.get(), form);
        for (int level = 0; level < 40000; ++level) {
            stream << Web::classId.w0 << Web::classId.w1 << Web::classId.w2 << Web::classId.w3 << 1;
            if (form == Form::binary) stream << 1000U;
            stream << 1.0f;
        }
        device->seek(0, 0);
        EXPECT_THROW(stream.readObject(nullptr), Ov::ExBadCast);
        EXPECT_LT(device->seek(0, 1), 200);
    }
    const auto device = Ov::rnCreate<Ov::RnMemoryBuffer>();
    Ov::RnStream stream(device.get(), Form::binary);
    stream << static_cast<const Ov::RnCastable*>(Ov::rnCreate<Web>()->getCastable());  // without one
    device->seek(0, 0);
    EXPECT_THROW(stream.readObject(nullptr), Ov::ExBadCast);
}

}  // namespace
}  // namespace OvPhotometrics
