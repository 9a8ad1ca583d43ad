#include <bit>
#include <cmath>
#include <functional>
#include <limits>
#include <numbers>
#include <random>

#include "components/photo/lid/fluxIntegral.h"
#include "components/photo/lid/webEvaluation.h"
#include "tests/photo/photoFixture.h"

// Installing records, and the queries of an installed web.

namespace OvPhotometrics {
namespace {

using enum PhotoWebSymmetry;
using Value = std::function<double(double theta, double psi)>;

/// A record on evenly spread angles, in degrees, with given values.
struct Grid {
    int nthetas = 7;
    int npsis = 5;
    PhotoWebSymmetry symmetry = Half;
    double lastTheta = 180;
    double lastPsi = 180;
    double firstTheta = 0;
    double firstPsi = 0;
    bool truncated = false;

    void fill(PhotoWebRecord& rec, const Value& value) const {
        photoWebRecordInit(rec, nthetas, npsis, symmetry, truncated, true, L"grid");
        for (int i = 0; i < nthetas; ++i)
            photoWebRecordSetTheta(rec, i, toRadians(firstTheta + (lastTheta - firstTheta) * i / (nthetas - 1)));
        for (int j = 0; j < npsis; ++j) {
            const double psi = npsis > 1 ? firstPsi + (lastPsi - firstPsi) * j / (npsis - 1) : 0;
            photoWebRecordSetPsi(rec, j, toRadians(psi));
            for (int i = 0; i < nthetas; ++i)
                photoWebRecordSetCandela(
                    rec, i, j, static_cast<float>(value(rec.thetas[static_cast<std::size_t>(i)], rec.psis[j])));
        }
    }
};

class PhotoWeb : public Photo {
protected:
    RnRef<PhotoWebIES> webOf(const Grid& grid, const Value& value, float lumens = 0) {
        PhotoWebRecord rec;
        grid.fill(rec, value);
        photoWebRecordSetLumens(rec, lumens);
        auto web = Ov::rnCreate<PhotoWebIES>();
        EXPECT_TRUE(photoWebInstall(*web, rec));
        return web;
    }
};

const Value one = [](double, double) { return 1; };
const Value wavy = [](double theta, double psi) { return 2 + std::cos(3 * theta) + std::sin(psi); };

TEST_F(PhotoWeb, InstallChecksTheAngles) {
    const struct {
        const char* name;
        Grid grid;
        const char* message;
    } cases[] = {
        {"full to 360", {.symmetry = Full, .lastPsi = 360}, ""},
        {"full to 361", {.symmetry = Full, .lastPsi = 361}, "12928"},
        {"full within the tolerance", {.symmetry = Full, .lastPsi = 360.2}, ""},
        {"half to 181", {.lastPsi = 181}, "12929"},
        {"half to 0.1", {.lastPsi = 0.1}, "12929"},
        {"quarter to 91", {.symmetry = Quarter, .lastPsi = 91}, "12930"},
        {"axial with 2 planes", {.npsis = 2, .symmetry = Axial}, "12931"},
        {"first psi 0.2", {.firstPsi = 0.2}, ""},
        {"first psi 0.3", {.firstPsi = 0.3}, "12927"},
        {"thetas fall", {.lastTheta = 0, .firstTheta = 90}, "12925"},
        {"psis fall", {.lastPsi = -90}, "12926"},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        PhotoWebRecord rec;
        c.grid.fill(rec, one);
        if (c.grid.symmetry == Axial) rec.psis[1] = 1;  // the setter leaves it alone
        const auto web = Ov::rnCreate<PhotoWebIES>();
        EXPECT_EQ(photoWebInstall(*web, rec), *c.message == 0);
        EXPECT_EQ(log.take(), c.message);
        EXPECT_EQ(web->getThetaCount(), *c.message ? 0 : 7);
    }
}

TEST_F(PhotoWeb, WhatIsNotFiniteIsRefused) {
    constexpr double infinite = std::numeric_limits<double>::infinity();
    for (const double bad : {infinite, -infinite, std::nan(""), 3e38}) {  // of the last, the flux
        PhotoWebRecord rec;
        Grid{}.fill(rec, [&](double theta, double) { return theta > 1 ? bad : 1; });
        const auto web = Ov::rnCreate<PhotoWebIES>();
        EXPECT_FALSE(photoWebInstall(*web, rec)) << bad;
        EXPECT_EQ(web->getPsiCount(), 0);
    }
    PhotoWebRecord huge;
    EXPECT_THROW(photoWebRecordInit(huge, 2147483647, 2147483647, Full, false, true, L"x"), std::bad_alloc);
    EXPECT_EQ(huge.nthetas, 0);
}

TEST_F(PhotoWeb, FluxIsTheIntegral) {
    // Intensity 10 cd everywhere is 40 pi lm, whatever the symmetry and the number of vertical angles.
    const double sphere = 40 * std::numbers::pi;
    const Value ten = [](double, double) { return 10; };
    for (const int n : {2, 3, 19, 29, 30, 181}) {
        const Grid grids[] = {{.nthetas = n, .npsis = 24, .symmetry = Full, .lastPsi = 345},
                              {.nthetas = n, .symmetry = Full, .lastPsi = 360},
                              {.nthetas = n, .symmetry = Half},
                              {.nthetas = n, .symmetry = Half, .lastPsi = 120},
                              {.nthetas = n, .symmetry = Quarter, .lastPsi = 90},
                              {.nthetas = n, .npsis = 1, .symmetry = Axial}};
        for (const Grid& grid : grids) EXPECT_NEAR(webOf(grid, ten)->getLumens(), sphere, 0.002 * sphere) << n;
    }
    const Grid cut{.nthetas = 91, .symmetry = Half, .lastPsi = 90, .truncated = true};
    EXPECT_NEAR(webOf(cut, ten)->getLumens(), sphere / 2, 0.002 * sphere);
    EXPECT_EQ(webOf(cut, ten, 123)->getLumens(), 123);
    EXPECT_EQ(webOf(cut, [](double, double) { return -1; })->getLumens(), 0);
}

TEST_F(PhotoWeb, ARowIsIntegratedWithTheSineOfItsAngles) {
    // The integral of t sin(t) is sin(t) - t cos(t): exact for values that are linear in the angle.
    const auto antiderivative = [](double t) { return std::sin(t) - t * std::cos(t) - 5 * std::cos(t); };
    for (const int n : {2, 3, 29, 30, 181})
        for (const auto& [first, last] : {std::pair{0.0f, pi}, std::pair{0.5f, 1.2f}, std::pair{halfPi, pi}}) {
            std::vector<float> angles, values;
            for (int k = 0; k < n; ++k) {
                angles.push_back(first + (last - first) * static_cast<float>(k) / static_cast<float>(n - 1));
                values.push_back(angles.back() + 5);
            }
            const double exact = antiderivative(last) - antiderivative(first);
            EXPECT_NEAR(photoWebIntegrate(n, angles.data(), values.data()), exact, 0.001 * exact)
                << n << " " << first;
            for (const int few : {0, 1}) EXPECT_EQ(photoWebIntegrate(few, angles.data(), values.data()), 0);
        }
}

TEST_F(PhotoWeb, IndicesFold) {
    const struct {
        PhotoWebSymmetry symmetry;
        int n, j, folded;
    } cases[] = {{Half, 3, -1, 1},   {Half, 3, 3, 1},    {Half, 3, 4, 0},    {Half, 3, 9, 1},
                 {Quarter, 3, 5, 1}, {Quarter, 2, 2, 0}, {Quarter, 2, 3, 1}, {Full, 4, -1, 3},
                 {Full, 4, 4, 0},    {Full, 4, 11, 3},   {Axial, 1, 5, 0},   {Half, 1, 7, 0}};
    for (const auto& c : cases)
        EXPECT_EQ(photoWebFoldPsiIndex(c.j, c.n, c.symmetry), c.folded) << c.n << " " << c.j;
}

TEST_F(PhotoWeb, BlocksWrapReflectAndClamp) {
    const auto rows = [&](PhotoWebSymmetry symmetry, int first) {
        const auto web = webOf({.nthetas = 3, .npsis = 4, .symmetry = symmetry, .lastPsi = 90},
                               [](double, double psi) { return std::round(1 + psi / (std::numbers::pi / 6)); });
        float block[6 * 5];
        web->getCandelaBlock({first, first + 5}, {-1, 3}, block);
        std::string result;
        for (int h = 0; h < 6; ++h) result += std::to_string(std::lround(block[5 * h + 4] * 4)) + " ";
        return result;
    };
    EXPECT_EQ(rows(Full, -1), "4 1 2 3 4 1 ");
    EXPECT_EQ(rows(Full, 3), "4 1 2 3 4 1 ");
    EXPECT_EQ(rows(Half, -1), "2 1 2 3 4 3 ");
    EXPECT_EQ(rows(Quarter, 2), "3 4 3 2 1 2 ");
    EXPECT_THROW(rows(Full, -2), Ov::ExAssertion);
    EXPECT_THROW(rows(Half, 4), Ov::ExAssertion);
}

TEST_F(PhotoWeb, BlocksOfAnyRangesHaveAsManyValuesAsTheseSay) {
    constexpr int most = std::numeric_limits<int>::max(), least = std::numeric_limits<int>::min();
    const auto valuesOf = [](const Ov::RnPhotoWebData& web, IndexRange psis, IndexRange thetas) {
        std::array<float, 8> block;
        block.fill(-1);
        web.getCandelaBlock(psis, thetas, block.data());
        return std::ranges::find(block, -1) - block.begin();
    };
    const auto axial = webOf({.nthetas = 3, .npsis = 1, .symmetry = Axial}, one);
    const auto half = webOf({.nthetas = 3, .npsis = 4}, one), empty = Ov::rnCreate<PhotoWebIES>();
    for (const auto& web : {axial, half, empty}) {
        for (const IndexRange alone : {IndexRange{most, most}, IndexRange{least, least}, IndexRange{1, 1}}) {
            EXPECT_EQ(valuesOf(*web, {0, 1}, alone), 2);
            EXPECT_EQ(valuesOf(*web, web.get() == half.get() ? IndexRange{1, 1} : alone, {0, 1}), 2);
        }
        for (const IndexRange none : {IndexRange{2, 0}, IndexRange{1, 0}, IndexRange{1, least}}) {
            EXPECT_EQ(valuesOf(*web, {0, 1}, none), 0);
            EXPECT_EQ(valuesOf(*web, none, {0, 1}), 0);
        }
    }
    EXPECT_THROW(valuesOf(*half, {most, most}, {0, 1}), Ov::ExAssertion);
}

TEST_F(PhotoWeb, ANodeIsItsSampleAndMirrorsAgree) {
    for (const Grid& grid : {Grid{.npsis = 8, .symmetry = Full, .lastPsi = 315}, Grid{}, Grid{.nthetas = 40},
                             Grid{.symmetry = Quarter, .lastPsi = 90}, Grid{.npsis = 1, .symmetry = Axial}}) {
        const auto web = webOf(grid, wavy);
        for (int j = 0; j < web->getPsiCount(); ++j)
            for (int i = 0; i < web->getThetaCount(); ++i)
                EXPECT_NEAR(web->getIntensity(web->getTheta(i), web->getPsi(j)), web->getCandela(j, i), 1e-5);
        for (float psi = 0; psi < 6; psi += 0.37f) {
            const float value = web->getIntensity(1.3f, psi);
            EXPECT_EQ(web->getIntensity(1.3f, psi - twoPi) > 0, value > 0);
            EXPECT_NEAR(web->getIntensity(1.3f, grid.symmetry == Full ? psi : twoPi - psi), value, 1e-5) << psi;
            const bool isQuarter = grid.symmetry == Quarter || grid.symmetry == Axial;
            EXPECT_NEAR(web->getIntensity(1.3f, isQuarter ? pi - psi : psi), value, 1e-5) << psi;
        }
    }
}

TEST_F(PhotoWeb, IsDarkOutsideItsRanges) {
    const auto lower = webOf({.lastTheta = 90}, wavy);
    EXPECT_GT(lower->getIntensity(lower->getThetaRange().last, 0), 0);
    EXPECT_EQ(lower->getIntensity(1.75f, 0), 0);
    EXPECT_EQ(lower->getIntensity(-1, 0), lower->getIntensity(0, 0));
    const auto cut = webOf({.symmetry = Full, .lastPsi = 180, .truncated = true}, wavy);
    EXPECT_EQ(cut->getIntensity(1, 3.4f), 0);
    const auto ringing = webOf({.nthetas = 30}, [](double theta, double) { return theta < 1 ? 1 : 0; });
    for (float theta = 0; theta < 3; theta += 0.01f) EXPECT_GE(ringing->getIntensity(theta, 0), 0);
    for (const float bad : {std::nanf(""), -std::nanf("")}) {
        EXPECT_EQ(lower->getIntensity(bad, 0), 0);
        EXPECT_EQ(lower->getIntensity(0, bad), 0);
    }
}

TEST_F(PhotoWeb, AnEmptyWebAnswersEveryQuery) {
    const auto web = Ov::rnCreate<PhotoWebIES>();
    float block[16] = {1};
    web->getCandelaBlock({-1, 2}, {-1, 2}, block);
    EXPECT_EQ(block[0], 0);
    EXPECT_EQ(web->getIntensity(0, 0) + web->getCandela(-1, 5) + web->getTheta(3) + web->getPsi(-1), 0);
    EXPECT_EQ(web->findTheta(1), -1);
    EXPECT_EQ(web->getThetaRange().last + web->getPsiRange().last, 0);
    EXPECT_EQ(web->clone()->getThetaCount(), 0);
    const auto named = webOf({}, wavy);
    const auto clone = named->clone();
    EXPECT_STREQ(named->getName(), L"grid");
    EXPECT_STREQ(clone->getName(), L"");
    EXPECT_FALSE(clone->isLoaded());
}

TEST_F(PhotoWeb, TheSearchIsThatOfTheWholeList) {
    std::mt19937 random(7);
    for (int n = 0; n < 40; ++n) {
        std::vector<float> angles;
        for (int k = 0; k < n; ++k)
            angles.push_back(static_cast<float>(random() % 16) * (n % 3 ? 1.0f : 0.25f * static_cast<float>(k)));
        std::sort(angles.begin(), angles.end());
        for (float a = -1; a < 40; a += 0.125f) {
            int k = n - 1;
            while (k > 0 && angles[static_cast<std::size_t>(k)] > a) --k;
            ASSERT_EQ(lastAtMost(angles.data(), n, a), k) << n << " " << a;
        }
    }
}

/// A web that overrides one query.
class Shifted final : public Ov::RnCastHeap<Ov::RnCastImpl<RnBasePhotoWebData, Ov::RnPhotoWebData>> {
public:
    RnRef<Ov::RnPhotoWebData> clone() const override { return {}; }
    int findTheta(float angle) const override { return std::min(RnBasePhotoWebData::findTheta(angle) + 1, 6); }
};

TEST_F(PhotoWeb, AnOverriddenQueryChangesTheEvaluation) {
    PhotoWebRecord rec;
    Grid{}.fill(rec, wavy);
    const auto plain = Ov::rnCreate<PhotoWebIES>();
    const auto shifted = Ov::rnCreate<Shifted>();
    ASSERT_TRUE(photoWebInstall(*plain, rec) && photoWebInstall(*shifted, rec));
    EXPECT_NE(shifted->getIntensity(1, 1), plain->getIntensity(1, 1));
    for (float theta = 0; theta < 3.1f; theta += 0.03f)
        EXPECT_EQ(plain->getIntensity(theta, theta), plain->RnBasePhotoWebData::getIntensity(theta, theta));
}

TEST_F(PhotoWeb, ManyDirectionsAreAnsweredAsEachIs) {
    constexpr float inf = std::numeric_limits<float>::infinity();
    const Grid grids[] = {
        {.nthetas = 19, .npsis = 8, .symmetry = Full, .lastPsi = 315},
        {.nthetas = 73, .npsis = 37, .symmetry = Full, .lastPsi = 360, .firstPsi = 0.2},
        {.npsis = 2, .symmetry = Full, .lastPsi = 90},
        {.npsis = 9, .symmetry = Full, .lastPsi = 180, .truncated = true},
        {},
        {.nthetas = 2, .npsis = 2, .lastTheta = 90, .lastPsi = 120},
        {.npsis = 3, .lastPsi = 90, .firstTheta = 30, .truncated = true},
        {.npsis = 4, .symmetry = Quarter, .lastPsi = 90},
        {.nthetas = 3, .npsis = 2, .symmetry = Quarter, .lastPsi = 60},
        {.npsis = 1, .symmetry = Axial, .truncated = true},
    };
    std::mt19937 random(3);
    std::uniform_real_distribution<float> wide(-7, 7);
    for (const Grid& grid : grids) {
        for (const bool even : {true, false}) {
            SCOPED_TRACE(testing::Message() << &grid - grids << (even ? " even" : " uneven"));
            PhotoWebRecord rec;
            grid.fill(rec, [&](double, double) { return wide(random); });
            for (int i = 1; i + 1 < grid.nthetas && !even; ++i)
                if (float* const theta = &rec.thetas[static_cast<std::size_t>(i)]; i % 3)
                    *theta = theta[-1] + (i % 3 == 1 ? 0 : 0.01f);
            const auto web = Ov::rnCreate<PhotoWebIES>();
            ASSERT_TRUE(photoWebInstall(*web, rec));

            std::vector<float> marks = {0,      -0.0f, 1e-30f, pi,  -pi,  twoPi,
                                        halfPi, 7,     1e30f,  inf, -inf, std::nanf("")};
            for (int i = 0; i < web->getThetaCount(); ++i) marks.push_back(web->getTheta(i));
            for (int j = 0; j < web->getPsiCount(); ++j) marks.push_back(web->getPsi(j));
            for (std::size_t k = marks.size(); k-- > 0;)
                for (const float side : {-inf, inf}) marks.push_back(std::nextafter(marks[k], side));
            std::vector<float> angles;
            for (const float theta : marks)
                for (const float psi : marks) angles.insert(angles.end(), {theta, psi});
            for (int k = 0; k < 999; ++k) angles.push_back(wide(random));
            const std::size_t count = angles.size() / 2;
            std::vector<float> out(count);
            for (int width = 0; width <= static_cast<int>(widestInstructions()); ++width) {
                evaluateGrid(web->grid(), angles.data(), count, out.data(), static_cast<Instructions>(width));
                for (std::size_t k = 0; k < count; ++k)
                    ASSERT_EQ(std::bit_cast<std::uint32_t>(out[k]),
                              std::bit_cast<std::uint32_t>(web->getIntensity(angles[2 * k], angles[2 * k + 1])))
                        << width << ": " << angles[2 * k] << " " << angles[2 * k + 1];
            }
        }
    }
}

}  // namespace
}  // namespace OvPhotometrics
