#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/web.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

class Distributions : public Photo {};

TEST_F(Distributions, IsotropicFluxAndIntensity) {
    const auto lamp = Ov::rnCreate<Isotropic>();
    lamp->setFlux(1000);
    EXPECT_FLOAT_EQ(lamp->getPeakIntensity(), 79.577469f);
    EXPECT_FLOAT_EQ(lamp->getFlux(), 1000);
    EXPECT_EQ(lamp->intensityAt({0, 0, 0}), lamp->candela);
    EXPECT_THROW(lamp->toLocalNormalized({0, 0, 0}), Ov::ExAssertion);
    const auto clone = lamp->clone();
    clone->setPeakIntensity(1);
    EXPECT_FLOAT_EQ(lamp->getPeakIntensity(), 79.577469f);
}

TEST_F(Distributions, SavedOnesReadBackExactly) {
    for (const auto form : {Ov::RnStream::Form::text, Ov::RnStream::Form::binary}) {
        const auto lamp = Ov::rnCreate<Isotropic>();
        lamp->candela = 0.1f;
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), form);
        stream << static_cast<const Ov::RnCastable*>(lamp.get());
        stream << static_cast<const Ov::RnCastable*>(
            Ov::rnCreate<Web>().get());  // a web distribution without a web
        io->seek(0, 0);
        const auto object = stream.readObject(&Ov::RnIntensityDist::iid);
        EXPECT_EQ(Ov::rnCast<Ov::RnIntensityDist>(object.get())->getPeakIntensity(), 0.1f);
        EXPECT_THROW(stream.readObject(nullptr), Ov::ExBadCast);
    }
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
    light->setWeb(&immortal<WebBuilder>());  // no web
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

TEST_F(Distributions, LoadingBringsDerivedValuesUpToDate) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
    Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
    const auto light = makeWebDistribution(*import(IesText{.horizontal = {90, 180, 270}}.text()));
    light->setPeakIntensity(7);
    Ov::rnCast<Ov::RnPersistant>(light.get())->save(stream);
    io->seek(0, 0);
    const auto loaded = Ov::rnCreate<Web>();
    Ov::rnCast<Ov::RnPersistant>(loaded.get())->load(stream, 0, nullptr, nullptr);
    EXPECT_EQ(loaded->getPeakIntensity(), 7);
    // The web's text holds relative values, so what stands for the saved web now has a peak of 1.
    EXPECT_EQ(loaded->getWeb()->getMaxCandela(), 1);
    EXPECT_GT(light->intensityAtUnit(direction(90, 100)), 0);
    EXPECT_NEAR(loaded->localIntensity(1, 1), light->localIntensity(1, 1), 7 * 0.01);

    const auto bad = Ov::rnCreate<Ov::RnMemoryBuffer>("5 1 2 3 4 1\nno object");
    Ov::RnStream other(bad.get(), Ov::RnStream::Form::text);
    EXPECT_ANY_THROW(Ov::rnCast<Ov::RnPersistant>(loaded.get())->load(other, 0, nullptr, nullptr));
    EXPECT_EQ(loaded->getPeakIntensity(), 7);
}

}  // namespace
}  // namespace OvPhotometrics
