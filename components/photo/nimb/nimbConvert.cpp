#include <algorithm>
#include <cmath>

#include "components/photo/files/gridLayout.h"
#include "components/photo/files/ownGrid.h"
#include "components/photo/files/sampling.h"
#include "components/photo/files/webDistribution.h"
#include "components/photo/lid/angleSearch.h"
#include "components/photo/lid/withinMemory.h"
#include "components/photo/nimb/nimb.h"

namespace OvPhotometrics {

namespace {

constexpr float lampLumens = 1000;  // of every file

PhotoWebSymmetry symmetryOf(int psiMax) {
    switch (psiMax) {
        case 0:
            return PhotoWebSymmetry::Axial;
        case 90:
            return PhotoWebSymmetry::Quarter;
        case 180:
            return PhotoWebSymmetry::Half;
        default:
            return PhotoWebSymmetry::Full;
    }
}

void fillWebRecord(PhotoWebRecord& webRecord, const NimbRecord& rec) {
    auto value = rec.values.begin();
    for (int i = 0; i < rec.psiCount(); ++i) photoWebRecordSetPsi(webRecord, i, toRadians(i * rec.psiStep));
    for (int j = 0; j < rec.thetaCount(); ++j) {
        photoWebRecordSetTheta(webRecord, j, toRadians(j * rec.thetaStep));
        for (int i = 0; i < rec.psiCount(); ++i) photoWebRecordSetCandela(webRecord, j, i, *value++);
    }
    webRecord.file.lampLumens = lampLumens;
    if (rec.orientationAngle != 90)
        photoWebRecordSetOrientation(webRecord, turnedBy(static_cast<float>(90 - rec.orientationAngle)));
}

/// How many angles there are on one axis, and the smallest step between them in radians.
struct Spacing {
    int count;
    float step;
};

Spacing spacingOf(AngleRange range) {
    const float width = range.last - range.first;
    const float tens = width / toRadians(10);
    const int count = std::fabs(tens) < 1000 ? static_cast<int>(tens) : 0;
    return {count, width / static_cast<float>(count)};
}

template <class Angle>
Spacing spacingOf(int count, float widest, Angle angle) {
    return {count, smallestStep(count, widest, angle)};
}

/// The step to write, degrees: a divisor of 90, at least `least`; 90 where one angle or none leaves no quotient.
int stepInDegrees(const Spacing& spacing, int least) {
    const float degrees = static_cast<float>(inDegrees(spacing.step));
    const double step = degrees / static_cast<float>(spacing.count - 1) + 0.5;
    if (!std::isfinite(step) || step >= 90) return 90;
    if (step < least + 1) return least;
    int whole = static_cast<int>(step);
    while (90 % whole != 0) --whole;
    return whole;
}

void chooseSteps(Ov::RnIntensityDist& dist, NimbRecord& rec) {
    Spacing thetas = {};
    Spacing psis = {};
    if (const auto holder = Ov::rnQuery<Ov::RnWebIntensityDist>(&dist)) {
        const auto web = Ov::rnCast<Ov::RnPhotoWebData>(holder->getWeb());
        thetas = spacingOf(web->getThetaCount(), pi, [&](int k) { return web->getTheta(k); });
        psis = spacingOf(web->getPsiCount(), twoPi, [&](int k) { return web->getPsi(k); });
    } else {
        thetas = spacingOf(dist.getThetaRange());
        psis = spacingOf(dist.getPsiRange());
    }
    rec.thetaStep = stepInDegrees(thetas, 1);
    rec.psiStep = stepInDegrees(psis, 5);
}

void chooseRanges(const Ov::RnIntensityDist& dist, NimbRecord& rec) {
    rec.thetaMax = compareAngles(dist.getThetaRange().last, halfPi) > 0 ? 180 : 90;
    const float lastPsi = dist.getPsiRange().last;
    const auto about = [&](float angle) { return compareAngles(lastPsi, angle) == 0; };
    rec.psiMax = about(0) ? 0 : about(halfPi) ? 90 : about(pi) ? 180 : 360 - rec.psiStep;
}

std::int16_t rounded(float value) {
    if (value > 9999) return 9999;
    if (value < -999) return -999;
    return value == value ? static_cast<std::int16_t>(value + 0.5) : 0;
}

NimbRecord recordToWrite() {
    return {
        .lines = {L"Measurement unknown", L"Manufacturing company unknown", L"Type of luminaire unknown", L""}};
}

/// Fills the grid with what `intensity` answers by degrees, scaled to 1000 of `flux` lumens.
template <class Intensity>
void sample(NimbRecord& rec, float flux, Intensity intensity) {
    rec.values.assign(static_cast<std::size_t>(rec.valueCount()), 0);
    if (!(flux > 0) || !std::isfinite(flux)) return;
    const float scale = static_cast<float>(1000 / static_cast<double>(flux));
    auto value = rec.values.begin();
    for (int j = 0; j < rec.thetaCount(); ++j)
        for (int i = 0; i < rec.psiCount(); ++i)
            *value++ = rounded(intensity(j * rec.thetaStep, i * rec.psiStep) * scale);
}

/// The nearest whole candela that four characters hold.
std::int16_t whole(float candela) {
    return static_cast<std::int16_t>(std::clamp(std::round(candela), -999.0f, 9999.0f));
}

/// The whole degrees between angles that start at 0 and go up evenly, a divisor of 90; 0 for others.
int evenStep(int count, auto angleAt) {
    const int step = count > 1 ? static_cast<int>(std::lround(inDegrees(angleAt(1)))) : 0;
    if (step < 1 || 90 % step != 0) return 0;
    for (int k = 0; k < count; ++k)
        if (angleAt(k) != toRadians(k * step)) return 0;
    return step;
}

/// The header of a web's own grid. False when the format cannot hold that.
bool takeOwnGrid(const Ov::RnPhotoWebData& web, NimbRecord& rec) {
    const int thetas = web.getThetaCount();
    const int psis = web.getPsiCount();
    rec.thetaStep = evenStep(thetas, [&](int k) { return web.getTheta(k); });
    rec.thetaMax = (thetas - 1) * rec.thetaStep;
    const bool axial = web.getSymmetry() == PhotoWebSymmetry::Axial;
    rec.psiStep = axial ? 90 : evenStep(psis, [&](int k) { return web.getPsi(k); });
    rec.psiMax = (psis - 1) * rec.psiStep;
    if (web.isPsiTruncated() || rec.thetaStep == 0 || rec.psiStep == 0 || rec.thetaMax < 90 ||
        rec.thetaMax > 180 || symmetryOf(rec.psiMax) != web.getSymmetry() ||
        (web.getSymmetry() == PhotoWebSymmetry::Full && rec.psiMax != 360 - rec.psiStep))
        return false;
    for (const int angle : {90, 0, 180, -90}) {
        rec.orientationAngle = angle;
        if (isTurned(web, turnedBy(static_cast<float>(90 - angle)))) return true;
    }
    return false;
}

SamplingPlan planGrid(Ov::RnIntensityDist& dist, NimbRecord& rec) {
    SamplingPlan plan = planSampling(dist, {.wholeDegrees = true, .fromPole = true});
    rec.orientationAngle = 90;
    rec.thetaStep = static_cast<std::int32_t>(plan.thetaStep);
    rec.thetaMax = static_cast<std::int32_t>(plan.lastTheta);
    rec.psiStep = static_cast<std::int32_t>(plan.psiStep);
    rec.psiMax = static_cast<std::int32_t>(plan.lastPsi());
    if (plan.symmetry == PhotoWebSymmetry::Full) rec.psiMax -= rec.psiStep;  // plane 360 is plane 0
    return plan;
}

}  // namespace

bool nimbToWeb(const NimbRecord& rec, RnBasePhotoWebData& web, bool loaded, const wchar_t* name) {
    return installOrReport([&] {
        PhotoWebRecord webRecord;
        photoWebRecordInit(webRecord, rec.thetaCount(), rec.psiCount(), symmetryOf(rec.psiMax), false, loaded,
                           name);
        fillWebRecord(webRecord, rec);
        return photoWebInstall(web, webRecord);
    });
}

bool nimbRecordFromDistribution(Ov::RnIntensityDist& dist, NimbRecord& rec) {
    return withinMemory([&] {
        rec = recordToWrite();
        chooseSteps(dist, rec);
        chooseRanges(dist, rec);
        rec.symmetryCode1 = rec.symmetryCode2 = static_cast<std::int32_t>(dist.getSymmetry());
        sample(rec, dist.getFlux(),
               [&](int theta, int psi) { return dist.intensity(toRadians(theta), toRadians(psi)); });
        return true;
    });
}

bool nimbRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, NimbRecord& rec) {
    rec = recordToWrite();
    const auto web = webOf(dist);
    const bool own = web && takeOwnGrid(*web, rec);
    const SamplingPlan plan = own ? SamplingPlan() : planGrid(dist, rec);
    rec.symmetryCode1 = rec.symmetryCode2 = static_cast<std::int32_t>(symmetryOf(rec.psiMax));
    rec.values.reserve(static_cast<std::size_t>(rec.valueCount()));
    const HostView view(dist);
    for (int j = 0; j < rec.thetaCount(); ++j)
        for (int i = 0; i < rec.psiCount(); ++i)
            rec.values.push_back(whole(own ? dist.getPeakIntensity() * web->getCandela(i, j)
                                           : view.overCell(j * rec.thetaStep, i * rec.psiStep, plan)));
    return true;
}

}  // namespace OvPhotometrics
