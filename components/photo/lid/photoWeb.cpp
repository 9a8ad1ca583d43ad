#include "components/photo/lid/photoWeb.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <new>
#include <optional>
#include <span>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/fluxIntegral.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/lid/webEvaluation.h"

namespace OvPhotometrics {

namespace {

std::size_t checkedCount(int n) {
    if (n < 0) throw std::bad_array_new_length();
    return static_cast<std::size_t>(n);
}

std::unique_ptr<float[]> newFloats(std::size_t n) { return std::make_unique_for_overwrite<float[]>(n); }

/// Without a way out of the loop, which wide instructions can then do.
bool allFinite(std::span<const float> values) {
    int finite = 1;
    for (const float value : values) finite &= std::isfinite(value);
    return finite != 0;
}

bool ascends(const float* angles, int n) { return std::is_sorted(angles, angles + n); }

/// The same with values that are not yet set.
PhotoWebRecord copyWithoutValues(const PhotoWebRecord& rec) {
    PhotoWebRecord copy;
    photoWebRecordInit(copy, rec.nthetas, rec.npsis, rec.symmetry, rec.psiTruncated, rec.loaded, rec.name.c_str());
    std::copy_n(rec.thetas.get(), rec.angleCount(), copy.thetas.get());
    copy.maxCandela = rec.maxCandela;
    copy.lumens = rec.lumens;
    copy.orientation = rec.orientation;
    copy.identityOrientation = rec.identityOrientation;
    copy.file = rec.file;
    return copy;
}

/// Whether a distribution can hold the flux: whether candela and lumens that it works out of both are finite.
bool canBeHeld(float lumens, float maxCandela) {
    const float factor = lumensPerCandela(lumens, maxCandela);
    const float candela = lumens > 0 ? lumens / factor : 0;
    return std::isfinite(factor) && std::isfinite(candela) && std::isfinite(candela * factor);
}

/// The message that refuses the last psi for the symmetry, if any.
std::optional<Ov::Message<>> refusedPsiRange(const PhotoWebRecord& rec) {
    const bool axial = rec.symmetry == PhotoWebSymmetry::Axial;
    const float last = rec.psis[rec.npsis - 1];
    const bool fits =
        axial ? rec.npsis == 1 : compareAngles(last, 0) > 0 && compareAngles(last, psiExtent(rec.symmetry)) <= 0;
    if (fits) return std::nullopt;
    return axial                                       ? messages::axialCount
           : rec.symmetry == PhotoWebSymmetry::Quarter ? messages::quarterRange
           : rec.symmetry == PhotoWebSymmetry::Half    ? messages::halfRange
                                                       : messages::fullRange;
}

/// The value, or the nearest that is finite; 0 for none.
float held(float value) {
    constexpr float most = std::numeric_limits<float>::max();
    return value == value ? std::clamp(value, -most, most) : 0;
}

std::optional<Ov::Message<>> refusedAngles(const PhotoWebRecord& rec) {
    if (!ascends(rec.thetas.get(), rec.nthetas)) return messages::verticalAnglesNotAscending;
    if (!ascends(rec.psis, rec.npsis)) return messages::horizontalAnglesNotAscending;
    if (compareAngles(rec.psis[0], 0) != 0) return messages::firstHorizontalAngleNotZero;
    return refusedPsiRange(rec);
}

}  // namespace

void photoWebRecordInit(PhotoWebRecord& rec, int nthetas, int npsis, PhotoWebSymmetry symmetry, bool psiTruncated,
                        bool loaded, const wchar_t* name) {
    rec = PhotoWebRecord();
    rec.loaded = loaded;
    PhotoWebRecord filled;
    filled.loaded = loaded;
    if (name) filled.name = name;
    filled.candelas = newFloats(checkedCount(nthetas) * checkedCount(npsis));
    filled.thetas = newFloats(checkedCount(nthetas) + checkedCount(npsis));
    filled.psis = filled.thetas.get() + nthetas;
    filled.nthetas = nthetas;
    filled.npsis = npsis;
    filled.symmetry = symmetry;
    filled.psiTruncated = psiTruncated;
    if (symmetry == PhotoWebSymmetry::Axial && npsis > 0) filled.psis[0] = 0;
    rec = std::move(filled);
}

void photoWebRecordFree(PhotoWebRecord& rec) {
    rec.thetas.reset();
    rec.psis = nullptr;
    rec.candelas.reset();
    rec.nthetas = rec.npsis = 0;
    rec.name.clear();
}

void photoWebRecordSetTheta(PhotoWebRecord& rec, int i, float radians) {
    rec.thetas[checkedCount(std::clamp(i, 0, rec.nthetas - 1))] = radians;
}

void photoWebRecordSetPsi(PhotoWebRecord& rec, int j, float radians) {
    if (rec.symmetry != PhotoWebSymmetry::Axial)
        rec.psis[photoWebFoldPsiIndex(j, rec.npsis, rec.symmetry)] = radians;
}

void photoWebRecordSetCandela(PhotoWebRecord& rec, int i, int j, float candela) {
    const std::size_t row = checkedCount(photoWebFoldPsiIndex(j, rec.npsis, rec.symmetry));
    rec.candelas[row * checkedCount(rec.nthetas) + checkedCount(std::clamp(i, 0, rec.nthetas - 1))] = candela;
    if (candela > rec.maxCandela) rec.maxCandela = candela;
}

void photoWebRecordSetRow(PhotoWebRecord& rec, int j, const float* values, float factor) {
    float* row = rec.candelas.get() +
                 checkedCount(photoWebFoldPsiIndex(j, rec.npsis, rec.symmetry)) * checkedCount(rec.nthetas);
    float peak = rec.maxCandela;
    for (int i = 0; i < rec.nthetas; ++i) {
        row[i] = values[i] * factor;
        peak = row[i] > peak ? row[i] : peak;
    }
    rec.maxCandela = peak;
}

void photoWebRecordSetLumens(PhotoWebRecord& rec, float lumens) { rec.lumens = lumens; }

void photoWebRecordSetOrientation(PhotoWebRecord& rec, const GeLinearMatrix3<float>& orientation) {
    rec.orientation = orientation;
    rec.identityOrientation = false;
}

bool photoWebInstall(RnBasePhotoWebData& web, const PhotoWebRecord& rec) {
    // Check the angles.
    if (rec.nthetas <= 0 || rec.npsis <= 0) return false;
    if (const auto refused = refusedAngles(rec)) {
        reportMessage(*refused);
        return false;
    }

    // Everything that can fail comes before the first change of the web.
    PhotoWebRecord installed = copyWithoutValues(rec);
    const std::span<const float> values(rec.candelas.get(), rec.valueCount());
    installed.lumens = 0;
    if (const float peak = rec.maxCandela; peak > 0) {
        std::ranges::transform(values, installed.candelas.get(), [peak](float value) { return value / peak; });
        installed.lumens = rec.lumens > 0 ? rec.lumens : fluxOf(installed.grid(), peak);
    } else {
        std::ranges::copy(values, installed.candelas.get());
    }
    if (!std::isfinite(rec.maxCandela) || !std::isfinite(rec.lumens) || !std::isfinite(installed.lumens) ||
        !canBeHeld(installed.lumens, rec.maxCandela) || !allFinite({installed.candelas.get(), values.size()}))
        return false;

    // Nothing can fail any more.
    installed.orientation = rec.orientation.computeTranspose();
    if (rec.lumens > 0) installed.file.lampLumens = rec.lumens;
    web._content = std::move(installed);
    return true;
}

RnBasePhotoWebData::RnBasePhotoWebData(const RnBasePhotoWebData& other)
    : Ov::RnPhotoFileWeb(), _content(copyWithoutValues(other._content)) {
    std::copy_n(other._content.candelas.get(), _content.valueCount(), _content.candelas.get());
    _content.name.clear();
    _content.loaded = false;
}

GeVector3<float>& RnBasePhotoWebData::toWebFrame(GeVector3<float>& out, const GeVector3<float>& direction) const {
    out = _content.identityOrientation ? direction : (_content.orientation * direction).normalized();
    return out;
}

GeVector3<float>& RnBasePhotoWebData::toWebFrameUnit(GeVector3<float>& out,
                                                     const GeVector3<float>& direction) const {
    out = (_content.identityOrientation ? direction : _content.orientation * direction.measurable()).normalized();
    return out;
}

float RnBasePhotoWebData::getLuminaireLumens() const {
    if (empty() || !(_content.maxCandela > 0)) return 0;
    return held(fluxOf(grid(), _content.maxCandela) * _content.file.candelaFactor);
}

RnRef<Ov::RnPhotoWebData> RnBasePhotoWebData::inCandela() {
    const float lumens = _content.file.lampLumens > 0 ? _content.file.lampLumens : _content.lumens;
    if (_content.file.candelaFactor == 1 && lumens == _content.lumens)
        return RnRef<Ov::RnPhotoWebData>::share(this);
    auto copy = clone();
    auto& web = static_cast<RnBasePhotoWebData&>(*copy);
    web._content.name = _content.name;
    web._content.loaded = _content.loaded;
    web._content.maxCandela = held(_content.maxCandela * _content.file.candelaFactor);
    web._content.lumens = lumens;
    web._content.file.candelaFactor = 1;
    return copy;
}

float RnBasePhotoWebData::getIntensity(float theta, float psi) const { return evaluateWeb(*this, theta, psi); }

void RnBasePhotoWebData::getIntensities(const float* angles, std::size_t count, float* out) const {
    for (std::size_t k = 0; k < count; ++k) out[k] = getIntensity(angles[2 * k], angles[2 * k + 1]);
}

}  // namespace OvPhotometrics
