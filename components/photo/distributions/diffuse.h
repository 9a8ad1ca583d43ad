#pragma once

#include "components/photo/distributions/analytic.h"
#include "components/photo/lid/angles.h"
#include "components/photo/lid/lidBuilder.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

class Diffuse;
using DiffusePersistant = CandelaPersistant<Diffuse>;

/// A Lambertian emitter that faces +Z: candela times the cosine, 0 behind; flux = pi candela.
class Diffuse final : public CosineDist<Diffuse, DiffusePersistant, Ov::RnDiffuseIntensityDist> {
public:
    static constexpr BuilderInfo info{classIds::diffuse, distributionCategory, L"Diffuse Distribution",
                                      L"Diffuse Light Intensity Distribution"};
    static constexpr Ov::RnUid classId = info.classId;

    float law(float cosine) const { return cosine > 0 ? orDark(cosine * candela) : 0; }
    float getFlux() const override { return orDark(candela * pi); }
    void setFlux(float lumens) override { candela = lumens / pi; }
    AngleRange getThetaRange() const override { return {0, halfPi}; }
};

using DiffuseBuilder = ObjectBuilder<Diffuse>;

}  // namespace OvPhotometrics
