#pragma once

#include "components/photo/distributions/singlePrecision.h"
#include "components/photo/files/savedWeb.h"
#include "components/photo/lid/lidBuilder.h"
#include "components/photo/lid/photoWeb.h"
#include "components/support/castImpl.h"
#include "ovphoto/classIds.h"
#include "ovphoto/intensities.h"
#include "ovphoto/saveForm.h"

namespace OvPhotometrics {

class Web;

/// Writes the multiplier and the web as an object.
class WebPersistant final : public Ov::RnTempObject<Web> {
public:
    using RnTempObject::RnTempObject;
    void save(Ov::RnStream& stream) override;
    /// Brings the derived values up to date. A missing or other object raises ExBadCast; nothing has changed then.
    bool load(Ov::RnStream& stream, int, const wchar_t* name, const wchar_t* basePath) override;
};

/// Any photometric web as an intensity distribution. Without a web it is dark, axial, with the ranges {0, 0}.
class Web final : public Ov::RnDataObject2<Web, WebPersistant, Ov::RnWebIntensityDist, Ov::RnManyIntensities,
                                           Ov::RnWebIntensityDist, Ov::RnIntensityDist> {
public:
    static constexpr BuilderInfo info{classIds::webDistribution, distributionCategory, L"Web Distribution",
                                      L"Web Light Intensity Distribution"};
    static constexpr Ov::RnUid classId = info.classId;

    RnRef<Ov::RnIntensityDist> reference() override { return RnRef<Ov::RnIntensityDist>::share(this); }
    /// Shares the web.
    RnRef<Ov::RnIntensityDist> clone() const override { return Ov::rnCreate<Web>(*this); }
    float intensity(float theta, float psi) const override;
    float intensityAt(const GeVector3<float>& direction) const override;
    float intensityAtUnit(const GeVector3<float>& direction) const override;
    float localIntensity(float theta, float psi) const override;
    float localIntensityAt(const GeVector3<float>& direction) const override;
    float localIntensityAtUnit(const GeVector3<float>& direction) const override;
    bool query() const override { return false; }
    PhotoWebSymmetry getSymmetry() const override { return _web ? _web->getSymmetry() : PhotoWebSymmetry::Axial; }
    float getPeakIntensity() const override { return _multiplier; }
    void setPeakIntensity(float candela) override { _multiplier = candela; }
    float getFlux() const override { return orDark(_multiplier * _fluxFactor); }
    void setFlux(float lumens) override { _multiplier = _fluxFactor > 0 ? lumens / _fluxFactor : 0; }
    bool hasIdentityOrientation() const override { return _identityOrientation; }
    GeLinearMatrix3<float> getOrientation() const override;
    GeVector3<float> toLocal(const GeVector3<float>& unitDirection) const override;
    GeVector3<float> toLocalNormalized(const GeVector3<float>& direction) const override;
    AngleRange getThetaRange() const override { return _web ? _web->getThetaRange() : AngleRange{}; }
    AngleRange getPsiRange() const override;
    void hook() override {}
    Ov::RnPhotoWebData* getWeb() const override { return _web.get(); }
    void setWeb(Ov::RnCastable* web) override;
    bool getIntensities(Ov::DirectionForm form, const float* directions, std::int64_t count,
                        float* out) const override;

private:
    friend class WebPersistant;

    using Vector = GeVector3<float>;

    /// A number, and at most the largest.
    float candelaOf(float relative) const;
    // Directions in the web's frame.
    Vector fromHost(const Vector& direction) const;
    Vector fromHostUnit(const Vector& direction) const;
    /// Whether the web reaches there; then the angles are set.
    bool anglesOf(const Vector& local, float& theta, float& psi) const;

    template <class ToLocal>
    void intensitiesOfVectors(const RnBasePhotoWebData& web, const float* directions, std::size_t floats,
                              std::size_t count, float* out, ToLocal convert) const;
    void hold(RnRef<Ov::RnPhotoWebData> web);

    float _multiplier = 0;  // candela for a relative value of 1
    float _fluxFactor = 0;  // lumens for a multiplier of 1
    float _maxCandela = 0;  // dark unless above 0
    float _cosLast = 0;
    float _cosFirst = 0;
    RnRef<Ov::RnPhotoWebData> _web;
    bool _identityOrientation = false;
};

/// Builds web distributions, and has the setting of how the module's webs are saved.
class WebBuilder final
    : public InfoBuilder<
          Web, Ov::RnCastImpl2<LidBuilder, Ov::RnWebSaveForm, Ov::RnComponentBuilder, Ov::RnBuilderDescription>> {
public:
    bool isFaithful() const override { return websAreSavedFaithfully(); }
    void setFaithful(bool faithful) override { saveWebsFaithfully(faithful); }
};

}  // namespace OvPhotometrics
