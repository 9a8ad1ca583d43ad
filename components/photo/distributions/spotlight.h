#pragma once

#include "components/photo/distributions/analytic.h"
#include "components/photo/lid/lidBuilder.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

class Spotlight;

/// Writes candela and both cosines; what follows from them is worked out again.
class SpotlightPersistant final : public Ov::RnTempObject<Spotlight> {
public:
    using RnTempObject::RnTempObject;
    void save(Ov::RnStream& stream) override;
    /// Takes the cosines as they stand, without limits. Nothing has changed when the stream raises.
    bool load(Ov::RnStream& stream, int, const wchar_t*, const wchar_t*) override;
};

/// candela times cosine^exponent inside the falloff cone, where the exponent makes it half at the hotspot angle.
/// The flux is the integral of that over the cone.
class Spotlight final : public CosineDist<Spotlight, SpotlightPersistant, Ov::RnSpotlightIntensityDist> {
public:
    static constexpr BuilderInfo info{classIds::spotlight, distributionCategory, L"Spotlight Distribution",
                                      L"Spotlight Light Intensity Distribution"};
    static constexpr Ov::RnUid classId = info.classId;

    Spotlight() { setCosines(0.8660254f, 0.5f); }

    float law(float cosine) const {
        const bool lit = cosine >= _cosFalloff && _cosHotspot <= narrowest;
        return lit ? orDark(single::power(cosine, _exponent) * candela) : 0;
    }
    float getFlux() const override { return orDark(candela * _fluxFactor); }
    /// A spotlight that gives no light has no candela for any flux: 0.
    void setFlux(float lumens) override { candela = _fluxFactor > 0 ? lumens / _fluxFactor : 0; }
    /// Reaches to the wider of both angles.
    AngleRange getThetaRange() const override { return {0, _falloffAngle}; }
    float getHotspotCosine() const override { return _cosHotspot; }
    float getFalloffCosine() const override { return _cosFalloff; }
    void setHotspotCosine(float cosine) override;
    void setFalloffCosine(float cosine) override;

private:
    friend class SpotlightPersistant;

    static constexpr float narrowest = 0.99999845f;  // about 0.1 degree
    static constexpr float widest = 0.01745328f;     // about 89 degrees

    void setCosines(float hotspot, float falloff);

    float _fluxFactor = 0;  // lumens for a candela of 1
    float _cosFalloff = 0;
    float _cosHotspot = 0;
    float _falloffAngle = 0;
    float _exponent = 0;
};

using SpotlightBuilder = ObjectBuilder<Spotlight>;

}  // namespace OvPhotometrics
