#pragma once

#include <algorithm>
#include <memory>
#include <string>

#include "components/photo/lid/angleSearch.h"
#include "components/photo/lid/angles.h"
#include "components/photo/lid/gridEvaluation.h"
#include "ovphoto/photoFile.h"

// The photometric web in memory: the record that a format's reader fills, and the class behind RnPhotoWebData that
// a finished record is installed into.
//
// Units:    radians; candela in a record, values relative to the peak in an installed web; lumens.
// Layout:   candelas stand one psi row after another: the value of theta index i and psi index j is element
//           j * nthetas + i.

namespace OvPhotometrics {

using Ov::AngleRange;
using Ov::GeLinearMatrix3;
using Ov::GeVector3;
using Ov::IndexRange;
using Ov::RnEnum;
using Ov::RnRef;

/// What a web consists of: as a reader fills it and, with values relative to the peak and the orientation transposed,
/// as an object holds it. Owns its blocks.
struct PhotoWebRecord {
    std::wstring name;
    std::unique_ptr<float[]> thetas;  // one block: nthetas vertical angles, then npsis horizontal ones
    float* psis = nullptr;            // inside that block
    std::unique_ptr<float[]> candelas;
    float maxCandela = 0;  // the largest value set so far
    float lumens = 0;      // 0 or below: the file gives none
    GeLinearMatrix3<float> orientation;
    std::int32_t nthetas = 0;
    std::int32_t npsis = 0;
    PhotoWebSymmetry symmetry = PhotoWebSymmetry::Full;
    bool psiTruncated = false;  // nothing is emitted beyond the last psi
    bool identityOrientation = true;
    bool loaded = false;
    Ov::PhotoFileInfo file;  // lumens of lamps that `lumens` says need not stand here too

    std::size_t angleCount() const { return static_cast<std::size_t>(nthetas) + static_cast<std::size_t>(npsis); }
    std::size_t valueCount() const { return static_cast<std::size_t>(nthetas) * static_cast<std::size_t>(npsis); }
    WebGrid grid() const { return {thetas.get(), psis, candelas.get(), nthetas, npsis, symmetry, psiTruncated}; }
};

/// Starts a record: angles and candelas are allocated and not yet set (psi 0 of an axial web is 0). Throws
/// std::bad_alloc, also for sizes that cannot be held; the record is then empty.
void photoWebRecordInit(PhotoWebRecord& rec, int nthetas, int npsis, PhotoWebSymmetry symmetry, bool psiTruncated,
                        bool loaded, const wchar_t* name);
/// Lets go of the blocks and the name. A record does so itself at its end.
void photoWebRecordFree(PhotoWebRecord& rec);

// Setters: theta indices are clamped, psi indices folded by symmetry.
void photoWebRecordSetTheta(PhotoWebRecord& rec, int i, float radians);
/// Nothing for an axial web.
void photoWebRecordSetPsi(PhotoWebRecord& rec, int j, float radians);
void photoWebRecordSetCandela(PhotoWebRecord& rec, int i, int j, float candela);
/// The whole row of psi index j: `values` times `factor`.
void photoWebRecordSetRow(PhotoWebRecord& rec, int j, const float* values, float factor);
void photoWebRecordSetLumens(PhotoWebRecord& rec, float lumens);
/// Counts as an orientation even when it is the identity.
void photoWebRecordSetOrientation(PhotoWebRecord& rec, const GeLinearMatrix3<float>& orientation);

/// The stored psi index that index j stands for, j = -1 and beyond the last included: around the circle for Full,
/// reflected at both ends for Half and Quarter, 0 for Axial.
inline int photoWebFoldPsiIndex(int j, int npsis, PhotoWebSymmetry symmetry) {
    const bool mirrored = symmetry == PhotoWebSymmetry::Half || symmetry == PhotoWebSymmetry::Quarter;
    if ((!mirrored && symmetry != PhotoWebSymmetry::Full) || npsis < 2) return 0;
    if (j >= 0 && j < npsis) return j;
    if (!mirrored) return j < 0 ? npsis - 1 : j % npsis;
    if (j < 0) return 1;
    const int r = j % (2 * npsis - 2);
    return r < npsis ? r : 2 * npsis - 2 - r;
}

class RnBasePhotoWebData;

/// The flux of a web over its peak: what a distribution multiplies its candela by to get lumens.
inline float lumensPerCandela(float lumens, float maxCandela) { return maxCandela > 0 ? lumens / maxCandela : 0; }

/// Checks a record and makes it the content of `web`: values relative to the peak, the flux integrated when the
/// record has none, the orientation transposed (it then carries host directions into the web's frame).
/// False, and nothing has changed, after a message about angles (12925 to 12931), or without one when the peak,
/// the flux, a value, or what a distribution works out of them is not finite. Throws std::bad_alloc with nothing changed.
bool photoWebInstall(RnBasePhotoWebData& web, const PhotoWebRecord& rec);

/// The web behind RnPhotoWebData; each format derives its own. Queries work from the members alone and allocate
/// nothing.
class RnBasePhotoWebData : public Ov::RnPhotoFileWeb {
public:
    RnBasePhotoWebData() = default;
    /// The grid, flux, peak, orientation, flags and file of `other`; no name, not loaded.
    RnBasePhotoWebData(const RnBasePhotoWebData& other);
    RnBasePhotoWebData& operator=(const RnBasePhotoWebData&) = delete;

    bool isLoaded() const override { return _content.loaded; }
    const wchar_t* getName() const override { return _content.name.c_str(); }
    PhotoWebSymmetry getSymmetry() const override { return _content.symmetry; }
    float getMaxCandela() const override { return _content.maxCandela; }
    float getLumens() const override { return _content.lumens; }
    bool hasIdentityOrientation() const override { return _content.identityOrientation; }
    GeLinearMatrix3<float> getOrientation() const override { return _content.orientation; }
    GeVector3<float>& toWebFrame(GeVector3<float>& out, const GeVector3<float>& direction) const override;
    GeVector3<float>& toWebFrameUnit(GeVector3<float>& out, const GeVector3<float>& direction) const override;
    bool isPsiTruncated() const override { return _content.psiTruncated; }
    AngleRange getThetaRange() const override {
        return _content.nthetas > 0 ? AngleRange{_content.thetas[0], _content.thetas.get()[_content.nthetas - 1]}
                                    : AngleRange{};
    }
    AngleRange getPsiRange() const override {
        return _content.npsis > 0 ? AngleRange{_content.psis[0], _content.psis[_content.npsis - 1]} : AngleRange{};
    }
    int findTheta(float angle) const override {
        return lastAtMost(_content.thetas.get(), _content.nthetas, angle);
    }
    int findPsi(float angle) const override { return lastAtMost(_content.psis, _content.npsis, angle); }
    int getThetaCount() const override { return _content.nthetas; }
    float getTheta(int index) const override {
        return _content.nthetas > 0 ? _content.thetas.get()[clampTheta(index)] : 0;
    }
    int getPsiCount() const override { return _content.npsis; }
    float getPsi(int index) const override {
        return _content.npsis > 0 ? _content.psis[photoWebFoldPsiIndex(index, _content.npsis, _content.symmetry)]
                                  : 0;
    }
    float getCandela(int psiIndex, int thetaIndex) const override {
        if (empty()) return 0;
        return row(photoWebFoldPsiIndex(psiIndex, _content.npsis, _content.symmetry))[clampTheta(thetaIndex)];
    }
    void getCandelaBlock(IndexRange psis, IndexRange thetas, float* out) const override;
    RnEnum::Action enumerateFiles(Ov::RnEnumerator<const wchar_t*>& visitor) const override {
        return visitor.finish();
    }
    float getIntensity(float theta, float psi) const override;
    const Ov::PhotoFileInfo& getFileInfo() const override { return _content.file; }
    float getLuminaireLumens() const override;
    RnRef<Ov::RnPhotoWebData> inCandela() override;

    /// Id by which the module knows its own webs among those of the host.
    static constexpr Ov::RnUid iid{0x7c1e9f10, 0x4a5b11ef, 0x9c6e0b62, 0x5d83a4f7};
    /// `getIntensity` towards `count` directions, a theta and a psi each.
    virtual void getIntensities(const float* angles, std::size_t count, float* out) const;
    WebGrid grid() const { return _content.grid(); }

protected:
    friend bool photoWebInstall(RnBasePhotoWebData& web, const PhotoWebRecord& rec);

    bool empty() const { return _content.nthetas <= 0 || _content.npsis <= 0; }
    int clampTheta(int i) const { return i <= 0 ? 0 : i < _content.nthetas ? i : _content.nthetas - 1; }
    const float* row(int j) const {
        return _content.candelas.get() + static_cast<std::size_t>(j) * static_cast<std::size_t>(_content.nthetas);
    }
    float* copyRow(int j, IndexRange thetas, float* out) const;

    PhotoWebRecord _content;
};

inline float* RnBasePhotoWebData::copyRow(int j, IndexRange thetas, float* out) const {
    const float* values = row(j);
    if (thetas.first >= 0 && thetas.last < _content.nthetas && thetas.first <= thetas.last) {
        // Nearly every block is 4 wide: a copy of known size is one instruction, others are a call.
        if (thetas.last - thetas.first == 3) return std::copy_n(values + thetas.first, 4, out);
        return std::copy(values + thetas.first, values + thetas.last + 1, out);
    }
    // Wider than an index, which ends at its largest value.
    for (std::int64_t i = thetas.first; i <= thetas.last; ++i) *out++ = values[clampTheta(static_cast<int>(i))];
    return out;
}

inline void RnBasePhotoWebData::getCandelaBlock(IndexRange psis, IndexRange thetas, float* out) const {
    if (empty()) {
        for (std::int64_t h = psis.first; h <= psis.last; ++h)
            for (std::int64_t i = thetas.first; i <= thetas.last; ++i) *out++ = 0;
        return;
    }
    // The one row of an axial web stands for all.
    if (_content.symmetry == PhotoWebSymmetry::Axial) {
        for (std::int64_t h = psis.first; h <= psis.last; ++h) out = copyRow(0, thetas, out);
        return;
    }

    // A block may start one plane before the first, and may end anywhere.
    const bool full = _content.symmetry == PhotoWebSymmetry::Full;
    if (!full && _content.symmetry != PhotoWebSymmetry::Half && _content.symmetry != PhotoWebSymmetry::Quarter)
        return;
    if (psis.first < -1 || psis.first >= _content.npsis)
        Ov::Assertions::throwAssertionFailed("h >= -1 && h < _npsis", "components/photo/lid/photoweb", __LINE__);

    // Rows wrap around the circle, or turn back at both ends.
    int step = 1;
    int j = psis.first;
    if (j < 0) {
        j = full ? _content.npsis - 1 : _content.npsis > 1 ? 1 : 0;
        step = full ? 1 : -1;
    }
    for (std::int64_t h = psis.first; h <= psis.last; ++h) {
        out = copyRow(j, thetas, out);
        if (_content.npsis == 1) continue;
        j += step;
        if (j >= 0 && j < _content.npsis) continue;
        if (full) {
            j = 0;
        } else {
            step = -step;
            j += 2 * step;
        }
    }
}

}  // namespace OvPhotometrics
