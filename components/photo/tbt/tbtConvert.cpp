#include <algorithm>
#include <cmath>
#include <limits>

#include "components/photo/files/sampling.h"
#include "components/photo/files/webDistribution.h"
#include "components/photo/lid/angleSearch.h"
#include "components/photo/lid/withinMemory.h"
#include "components/photo/tbt/tbt.h"

namespace OvPhotometrics {

namespace {

constexpr int mostVertical = 90;
constexpr int mostHorizontal = 180;

/// File codes count the other way.
PhotoWebSymmetry symmetryOf(std::int32_t code) { return static_cast<PhotoWebSymmetry>(4 - code); }
std::int32_t codeOf(PhotoWebSymmetry symmetry) { return 4 - static_cast<std::int32_t>(symmetry); }

float verticalAngle(int v, int count) { return static_cast<float>(v * exactPi / (count - 1)); }

float horizontalAngle(int h, int count, float range) {
    return h == 0 ? 0 : static_cast<float>(h) * range / static_cast<float>(count - 1);
}

/// How many angles cover a range evenly, both ends included, in steps of about `step`.
int countFor(double range, float step, int most) {
    if (!(step > 0)) return most;
    const double count = std::floor(range / step + 0.5) + 1;
    return static_cast<int>(std::clamp<double>(count, 2, most));
}

void chooseGrid(Ov::RnIntensityDist& dist, TbtFileRecord& rec) {
    const PhotoWebSymmetry symmetry = dist.getSymmetry();
    rec.symmetryCode = codeOf(symmetry);
    rec.verticalCount = mostVertical;
    rec.horizontalCount = mostHorizontal;
    if (const auto holder = Ov::rnQuery<Ov::RnWebIntensityDist>(&dist)) {
        const auto web = Ov::rnCast<Ov::RnPhotoWebData>(holder->getWeb());
        const float range = psiExtent(symmetry);
        const float vertical = smallestStep(web->getThetaCount(), pi, [&](int i) { return web->getTheta(i); });
        const float horizontal = smallestStep(web->getPsiCount(), range, [&](int j) { return web->getPsi(j); });
        rec.verticalCount = countFor(exactPi, vertical, mostVertical);
        rec.horizontalCount = countFor(range, horizontal, mostHorizontal);
    }
    if (symmetry == PhotoWebSymmetry::Axial) rec.horizontalCount = 1;
}

/// Fills the grid with what `intensity` answers by vertical and horizontal index, scaled to 1000 of `flux` lumens.
template <class Intensity>
void sample(TbtFileRecord& rec, float flux, Intensity intensity) {
    rec.values.assign(static_cast<std::size_t>(rec.verticalCount) * static_cast<std::size_t>(rec.horizontalCount),
                      0);
    rec.flux = flux;
    rec.multiplier = flux / 1000;
    const float scale = 1 / rec.multiplier;
    if (!std::isfinite(scale)) return;  // no flux, no light
    auto value = rec.values.begin();
    for (int h = 0; h < rec.horizontalCount; ++h)
        for (int v = 0; v < rec.verticalCount; ++v) *value++ = intensity(v, h) * scale;
}

/// What a value is multiplied by for candela. A file without a flux holds candela.
float candelaFactor(const TbtFileRecord& rec) {
    constexpr float most = std::numeric_limits<float>::max();
    return rec.flux > 0 ? std::min(static_cast<float>(double{rec.flux} / rec.referenceFlux), most) : 1;
}

void fillWebRecord(PhotoWebRecord& webRecord, const TbtFileRecord& rec) {
    const float range = psiExtent(webRecord.symmetry);
    for (int v = 0; v < rec.verticalCount; ++v)
        photoWebRecordSetTheta(webRecord, v, verticalAngle(v, rec.verticalCount));
    const float* row = rec.values.data();
    for (int h = 0; h < rec.horizontalCount; ++h, row += rec.verticalCount) {
        photoWebRecordSetPsi(webRecord, h, horizontalAngle(h, rec.horizontalCount, range));
        photoWebRecordSetRow(webRecord, h, row, 1);
    }
    photoWebRecordSetLumens(webRecord, rec.flux);
    webRecord.file.candelaFactor = candelaFactor(rec);
}

bool areAngles(int count, auto angleAt, auto expected) {
    constexpr double tolerance = 1e-6;  // radians
    for (int k = 0; k < count; ++k)
        if (!(std::fabs(double{angleAt(k)} - expected(k)) < tolerance)) return false;
    return true;
}

/// Whether values bend the light between angles that no number of the format can: those have no sign.
bool hasNegatives(const Ov::RnPhotoWebData& web) {
    for (int j = 0; j < web.getPsiCount(); ++j)
        for (int i = 0; i < web.getThetaCount(); ++i)
            if (web.getCandela(j, i) < 0) return true;
    return false;
}

/// The counts of a web's own grid. False when the format cannot hold that.
bool takeOwnGrid(const Ov::RnPhotoWebData& web, TbtFileRecord& rec) {
    const int vertical = web.getThetaCount();
    const int horizontal = web.getPsiCount();
    const float range = psiExtent(web.getSymmetry());
    if (web.isPsiTruncated() || !web.hasIdentityOrientation() || vertical < 2) return false;
    if (std::int64_t{vertical} * horizontal > tbtMostValues || hasNegatives(web)) return false;
    if (!areAngles(
            vertical, [&](int v) { return web.getTheta(v); }, [&](int v) { return verticalAngle(v, vertical); }) ||
        !areAngles(
            horizontal, [&](int h) { return web.getPsi(h); },
            [&](int h) { return horizontalAngle(h, horizontal, range); }))
        return false;
    rec.symmetryCode = codeOf(web.getSymmetry());
    rec.verticalCount = vertical;
    rec.horizontalCount = horizontal;
    return true;
}

/// Fills the grid with candela.
void fillFaithfully(Ov::RnIntensityDist& dist, TbtFileRecord& rec) {
    const auto web = webOf(dist);
    if (web && takeOwnGrid(*web, rec)) {
        for (int h = 0; h < rec.horizontalCount; ++h)
            for (int v = 0; v < rec.verticalCount; ++v)
                rec.values.push_back(dist.getPeakIntensity() * web->getCandela(h, v));
        return;
    }
    const SamplingPlan plan = planSampling(dist, {.wholeSphere = true, .planeKept = true});
    rec.symmetryCode = codeOf(plan.symmetry);
    rec.verticalCount = plan.thetaCount();
    rec.horizontalCount = plan.psiCount();
    const HostView view(dist);
    for (int h = 0; h < rec.horizontalCount; ++h)
        for (int v = 0; v < rec.verticalCount; ++v)
            rec.values.push_back(view.overCell(plan.theta(v), plan.psi(h), plan));
}

}  // namespace

bool tbtToWeb(const TbtFileRecord& rec, RnBasePhotoWebData& web, bool loaded, const wchar_t* name) {
    return installOrReport([&] {
        PhotoWebRecord webRecord;
        photoWebRecordInit(webRecord, rec.verticalCount, rec.horizontalCount, symmetryOf(rec.symmetryCode), false,
                           loaded, name);
        fillWebRecord(webRecord, rec);
        return photoWebInstall(web, webRecord);
    });
}

void tbtRecordInit(TbtFileRecord& rec) {
    rec = TbtFileRecord();
    rec.title = L"QRT photometric web";
}

bool tbtRecordFromDistribution(Ov::RnIntensityDist& dist, TbtFileRecord& rec) {
    return withinMemory([&] {
        tbtRecordInit(rec);
        chooseGrid(dist, rec);
        const float range = psiExtent(dist.getSymmetry());
        sample(rec, dist.getFlux(), [&](int v, int h) {
            return dist.intensity(verticalAngle(v, rec.verticalCount),
                                  horizontalAngle(h, rec.horizontalCount, range));
        });
        return true;
    });
}

bool tbtRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, TbtFileRecord& rec) {
    tbtRecordInit(rec);
    fillFaithfully(dist, rec);
    const float flux = dist.getFlux();
    tbtSetFlux(rec, flux > 0 ? flux : 0, rec.referenceFlux);
    return true;
}

void tbtSetFlux(TbtFileRecord& rec, float flux, float referenceFlux) {
    const double before = candelaFactor(rec);
    rec.flux = flux;
    rec.referenceFlux = referenceFlux;
    rec.multiplier = candelaFactor(rec);
    const double scale = before / rec.multiplier;
    for (float& value : rec.values) value = static_cast<float>(value * scale);
}

}  // namespace OvPhotometrics
