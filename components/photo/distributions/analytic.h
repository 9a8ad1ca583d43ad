#pragma once

#include "components/photo/distributions/singlePrecision.h"
#include "components/support/castImpl.h"
#include "host/componentManager/stream.h"
#include "ovphoto/intensityDist.h"

namespace OvPhotometrics {

using Ov::AngleRange;
using Ov::GeLinearMatrix3;
using Ov::GeVector3;
using Ov::PhotoWebSymmetry;
using Ov::RnRef;

/// What distributions given by a formula share, over their interface `Interface`: axially symmetric around +Z, the
/// same in both frames, with their intensity parameter in `candela`. `Self` adds the law, flux and range.
template <class Self, class Adapter, class Interface>
class AnalyticDist : public Ov::RnDataObject<Self, Adapter, Interface, Interface, Ov::RnIntensityDist> {
public:
    RnRef<Ov::RnIntensityDist> reference() override { return RnRef<Ov::RnIntensityDist>::share(this); }
    RnRef<Ov::RnIntensityDist> clone() const override {
        return Ov::rnCreate<Self>(static_cast<const Self&>(*this));
    }
    float localIntensity(float theta, float psi) const override { return this->intensity(theta, psi); }
    float localIntensityAt(const GeVector3<float>& direction) const override {
        return this->intensityAt(direction);
    }
    float localIntensityAtUnit(const GeVector3<float>& direction) const override {
        return this->intensityAtUnit(direction);
    }
    bool query() const override { return false; }
    PhotoWebSymmetry getSymmetry() const override { return PhotoWebSymmetry::Axial; }
    float getPeakIntensity() const override { return candela; }
    void setPeakIntensity(float value) override { candela = value; }
    bool hasIdentityOrientation() const override { return true; }
    GeLinearMatrix3<float> getOrientation() const override { return {}; }
    GeVector3<float> toLocal(const GeVector3<float>& unitDirection) const override { return unitDirection; }
    GeVector3<float> toLocalNormalized(const GeVector3<float>& direction) const override {
        return direction.normalized();
    }
    AngleRange getPsiRange() const override { return {0, 0}; }
    void hook() override {}

    float candela = 0;  // the intensity parameter, candela
};

/// An analytic distribution whose intensity follows from the cosine of the angle to the axis: `Self::law`. A zero
/// vector has no such angle; its cosine is NaN.
template <class Self, class Adapter, class Interface>
class CosineDist : public AnalyticDist<Self, Adapter, Interface> {
public:
    float intensity(float theta, float) const override { return self().law(single::cosine(theta)); }
    float intensityAt(const GeVector3<float>& direction) const override {
        const GeVector3<float> v = direction.measurable();
        return self().law(v.z / v.length());
    }
    float intensityAtUnit(const GeVector3<float>& direction) const override { return self().law(direction.z); }

private:
    const Self& self() const { return static_cast<const Self&>(*this); }
};

/// Saves and loads a distribution whose one field is `candela`.
template <class Data>
class CandelaPersistant final : public Ov::RnTempObject<Data> {
public:
    using Ov::RnTempObject<Data>::RnTempObject;
    void save(Ov::RnStream& stream) override { stream << this->data().candela; }
    bool load(Ov::RnStream& stream, int, const wchar_t*, const wchar_t*) override {
        float candela = 0;
        stream >> candela;
        this->data().candela = candela;
        return true;
    }
};

}  // namespace OvPhotometrics
