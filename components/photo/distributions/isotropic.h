#pragma once

#include "components/photo/distributions/analytic.h"
#include "components/photo/lid/angles.h"
#include "components/photo/lid/lidBuilder.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

class Isotropic;
using IsotropicPersistant = CandelaPersistant<Isotropic>;

/// The same intensity in every direction: flux = 4 pi candela.
class Isotropic final : public AnalyticDist<Isotropic, IsotropicPersistant, Ov::RnIsotropicIntensityDist> {
public:
    static constexpr BuilderInfo info{classIds::isotropic, distributionCategory, L"Isotropic Distribution",
                                      L"Isotropic Light Intensity Distribution"};
    static constexpr Ov::RnUid classId = info.classId;

    float intensity(float, float) const override { return orDark(candela); }
    float intensityAt(const GeVector3<float>&) const override { return orDark(candela); }
    float intensityAtUnit(const GeVector3<float>&) const override { return orDark(candela); }
    float getFlux() const override { return orDark(candela * fourPi); }
    void setFlux(float lumens) override { candela = lumens / fourPi; }
    AngleRange getThetaRange() const override { return {0, pi}; }
};

using IsotropicBuilder = ObjectBuilder<Isotropic>;

}  // namespace OvPhotometrics
