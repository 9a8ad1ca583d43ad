#include "components/photo/lid/photoWeb.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>
#include <new>
#include <optional>
#include <vector>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/lid/webEvaluation.h"

namespace OvPhotometrics {

namespace {

std::size_t count(int n) {
    if (n < 0) throw std::bad_array_new_length();
    return static_cast<std::size_t>(n);
}

std::unique_ptr<float[]> newFloats(std::size_t n) { return std::make_unique_for_overwrite<float[]>(n); }

/// Without a way out of the loop, which wide instructions can then do.
bool allFinite(const float* values, std::size_t n) {
    int finite = 1;
    for (std::size_t k = 0; k < n; ++k) finite &= std::isfinite(values[k]);
    return finite != 0;
}

bool ascends(const float* angles, int n) { return std::is_sorted(angles, angles + n); }

/// The flux integral over theta of many rows on one list of angles: the sines serve all rows.
class ThetaIntegral {
public:
    ThetaIntegral(int n, const float* angles)
        : _n(n), _angles(angles), _steps(n < 30 && n > 1 ? (n + 28) / (n - 1) : 1) {
        if (n < 2) return;
        _sines.reserve(count(n - 1) * count(_steps));
        for (int k = 1; k < n; ++k)
            if (subdivides())
                addSteps(k);
            else
                addSine((angles[k] + angles[k - 1]) / 2);
    }

    /// The integrals of `Rows` rows, one after another in memory. The sums of a row are a chain of dependent
    /// steps; several rows at once keep the machine busy.
    template <int Rows>
    std::array<float, Rows> of(const float* values) const {
        if (_n < 2) return {};
        return subdivides() ? sumOfSteps<Rows>(values) : sumOfIntervals<Rows>(values);
    }

private:
    bool subdivides() const { return _n < 30; }
    void addSine(float angle) { _sines.push_back(std::sin(static_cast<double>(angle))); }
    float stepOf(int k) const { return (_angles[k] - _angles[k - 1]) / static_cast<float>(_steps); }

    void addSteps(int k) {
        const float da = stepOf(k);
        float a = _angles[k - 1];
        for (int step = 0; step < _steps; ++step, a += da) addSine((a + da + a) * 0.5f);
    }

    template <int Rows>
    std::array<float, Rows> sumOfIntervals(const float* values) const {
        std::array<float, Rows> sums{};
        for (int k = 1; k < _n; ++k) {
            const double sine = _sines[count(k - 1)];
            const float da = _angles[k] - _angles[k - 1];
            for (int r = 0; r < Rows; ++r) {
                const float* v = values + static_cast<std::ptrdiff_t>(r) * _n + k;
                float& sum = sums[count(r)];
                sum = static_cast<float>(sum + sine * ((v[0] + v[-1]) * da));
            }
        }
        for (float& sum : sums) sum *= 0.5f;
        return sums;
    }

    template <int Rows>
    std::array<float, Rows> sumOfSteps(const float* values) const {
        std::array<float, Rows> totals{};
        for (int r = 0; r < Rows; ++r, values += _n) totals[count(r)] = sumOfSteps(values);
        return totals;
    }

    float sumOfSteps(const float* values) const {
        float total = 0;
        const double* sine = _sines.data();
        for (int k = 1; k < _n; ++k) {
            const float dv = (values[k] - values[k - 1]) / static_cast<float>(_steps);
            float v = values[k - 1];
            float sum = 0;
            for (int step = 0; step < _steps; ++step, v += dv)
                sum = static_cast<float>(sum + *sine++ * (v + dv + v));
            total += stepOf(k) * sum;
        }
        return total * 0.5f;
    }

    int _n;
    const float* _angles;
    int _steps;  // equal parts that an interval of a coarse list is cut into
    std::vector<double> _sines;
};

std::vector<float> integrateRows(const WebGrid& grid) {
    constexpr int together = 8;
    const ThetaIntegral integral(grid.nthetas, grid.thetas);
    std::vector<float> rows;
    rows.reserve(count(grid.npsis));
    const auto add = [&](const auto& sums) { rows.insert(rows.end(), sums.begin(), sums.end()); };
    int j = 0;
    const auto row = [&] { return grid.values + count(j) * count(grid.nthetas); };
    for (; j + together <= grid.npsis; j += together) add(integral.of<together>(row()));
    for (; j < grid.npsis; ++j) add(integral.of<1>(row()));
    return rows;
}

/// Flux in lumens of a grid whose values are relative to a peak of `maxCandela`.
float integrateFlux(const WebGrid& grid, float maxCandela) {
    const std::vector<float> rows = integrateRows(grid);
    const float first = rows.front();
    const float last = rows.back();
    float sum = 0;
    for (int j = 1; j < grid.npsis; ++j)
        sum += (rows[count(j)] + rows[count(j - 1)]) * (grid.psis[j] - grid.psis[j - 1]);
    const float lastPsi = grid.psis[grid.npsis - 1];
    switch (grid.symmetry) {
        case PhotoWebSymmetry::Full:
            if (!grid.psiTruncated) sum += ((grid.psis[0] + twoPi) - lastPsi) * (last + first);
            break;
        case PhotoWebSymmetry::Half:
            if (!grid.psiTruncated) sum += 2 * last * (pi - lastPsi);
            sum = 2 * sum;
            break;
        case PhotoWebSymmetry::Quarter:
            if (!grid.psiTruncated) sum += 2 * last * (halfPi - lastPsi);
            sum = 4 * sum;
            break;
        case PhotoWebSymmetry::Axial:
            sum = (first + first) * twoPi;
            break;
    }
    return sum * 0.5f * maxCandela;
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
    filled.candelas = newFloats(count(nthetas) * count(npsis));
    filled.thetas = newFloats(count(nthetas) + count(npsis));
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
    rec.thetas[count(std::clamp(i, 0, rec.nthetas - 1))] = radians;
}

void photoWebRecordSetPsi(PhotoWebRecord& rec, int j, float radians) {
    if (rec.symmetry != PhotoWebSymmetry::Axial)
        rec.psis[photoWebFoldPsiIndex(j, rec.npsis, rec.symmetry)] = radians;
}

void photoWebRecordSetCandela(PhotoWebRecord& rec, int i, int j, float candela) {
    const std::size_t row = count(photoWebFoldPsiIndex(j, rec.npsis, rec.symmetry));
    rec.candelas[row * count(rec.nthetas) + count(std::clamp(i, 0, rec.nthetas - 1))] = candela;
    if (candela > rec.maxCandela) rec.maxCandela = candela;
}

void photoWebRecordSetRow(PhotoWebRecord& rec, int j, const float* values, float factor) {
    float* row = rec.candelas.get() + count(photoWebFoldPsiIndex(j, rec.npsis, rec.symmetry)) * count(rec.nthetas);
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

float photoWebIntegrate(int n, const float* angles, const float* values) {
    return ThetaIntegral(n, angles).of<1>(values)[0];
}

bool photoWebInstall(RnBasePhotoWebData& web, const PhotoWebRecord& rec) {
    if (rec.nthetas <= 0 || rec.npsis <= 0) return false;
    if (const auto refused = refusedAngles(rec)) {
        reportMessage(*refused);
        return false;
    }

    // Everything that can fail comes before the first change of the web.
    const std::size_t values = count(rec.nthetas) * count(rec.npsis);
    const std::size_t angles = count(rec.nthetas) + count(rec.npsis);
    auto candelas = newFloats(values);
    auto thetas = newFloats(angles);
    std::wstring name = rec.name;
    std::copy_n(rec.thetas.get(), angles, thetas.get());
    float lumens = 0;
    if (rec.maxCandela > 0) {
        std::transform(rec.candelas.get(), rec.candelas.get() + values, candelas.get(),
                       [peak = rec.maxCandela](float value) { return value / peak; });
        lumens = rec.lumens > 0 ? rec.lumens
                                : integrateFlux({rec.thetas.get(), rec.psis, candelas.get(), rec.nthetas,
                                                 rec.npsis, rec.symmetry, rec.psiTruncated},
                                                rec.maxCandela);
    } else {
        std::copy_n(rec.candelas.get(), values, candelas.get());
    }
    if (!std::isfinite(rec.maxCandela) || !std::isfinite(rec.lumens) || !std::isfinite(lumens) ||
        !canBeHeld(lumens, rec.maxCandela) || !allFinite(candelas.get(), values))
        return false;

    web._name = std::move(name);
    web._thetas = std::move(thetas);
    web._psis = web._thetas.get() + rec.nthetas;
    web._candelas = std::move(candelas);
    web._maxCandela = rec.maxCandela;
    web._lumens = lumens;
    web._orientation = rec.orientation.computeTranspose();
    web._nthetas = rec.nthetas;
    web._npsis = rec.npsis;
    web._symmetry = rec.symmetry;
    web._psiTruncated = rec.psiTruncated;
    web._identityOrientation = rec.identityOrientation;
    web._loaded = rec.loaded;
    web._file = rec.file;
    if (rec.lumens > 0) web._file.lampLumens = rec.lumens;
    return true;
}

RnBasePhotoWebData::RnBasePhotoWebData(const RnBasePhotoWebData& other)
    : Ov::RnPhotoFileWeb(),
      _maxCandela(other._maxCandela),
      _lumens(other._lumens),
      _orientation(other._orientation),
      _nthetas(other._nthetas),
      _npsis(other._npsis),
      _symmetry(other._symmetry),
      _psiTruncated(other._psiTruncated),
      _identityOrientation(other._identityOrientation),
      _file(other._file) {
    if (!other._thetas) return;
    const std::size_t angles = count(_nthetas) + count(_npsis);
    const std::size_t values = count(_nthetas) * count(_npsis);
    _thetas = newFloats(angles);
    _candelas = newFloats(values);
    _psis = _thetas.get() + _nthetas;
    std::copy_n(other._thetas.get(), angles, _thetas.get());
    std::copy_n(other._candelas.get(), values, _candelas.get());
}

GeVector3<float>& RnBasePhotoWebData::toWebFrame(GeVector3<float>& out, const GeVector3<float>& direction) const {
    out = _identityOrientation ? direction : (_orientation * direction).normalized();
    return out;
}

GeVector3<float>& RnBasePhotoWebData::toWebFrameUnit(GeVector3<float>& out,
                                                     const GeVector3<float>& direction) const {
    out = (_identityOrientation ? direction : _orientation * direction.measurable()).normalized();
    return out;
}

float RnBasePhotoWebData::getLuminaireLumens() const {
    if (empty() || !(_maxCandela > 0)) return 0;
    return held(integrateFlux(grid(), _maxCandela) * _file.candelaFactor);
}

RnRef<Ov::RnPhotoWebData> RnBasePhotoWebData::inCandela() {
    const float lumens = _file.lampLumens > 0 ? _file.lampLumens : _lumens;
    if (_file.candelaFactor == 1 && lumens == _lumens) return RnRef<Ov::RnPhotoWebData>::share(this);
    auto copy = clone();
    auto& web = static_cast<RnBasePhotoWebData&>(*copy);
    web._name = _name;
    web._loaded = _loaded;
    web._maxCandela = held(_maxCandela * _file.candelaFactor);
    web._lumens = lumens;
    web._file.candelaFactor = 1;
    return copy;
}

float RnBasePhotoWebData::getIntensity(float theta, float psi) const { return evaluateWeb(*this, theta, psi); }

void RnBasePhotoWebData::getIntensities(const float* angles, std::size_t count, float* out) const {
    for (std::size_t k = 0; k < count; ++k) out[k] = getIntensity(angles[2 * k], angles[2 * k + 1]);
}

}  // namespace OvPhotometrics
