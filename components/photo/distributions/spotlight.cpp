#include "components/photo/distributions/spotlight.h"

#include <algorithm>

#include "components/photo/lid/angles.h"

namespace OvPhotometrics {

namespace {

/// The integral of cosine^exponent over the cone; over the whole hemisphere where `cosFalloff` is not above 0.
float coneFlux(float exponent, float cosFalloff) {
    float flux = static_cast<float>(2 * exactPi / (static_cast<double>(exponent) + 1));
    if (cosFalloff > 0) flux *= 1 - single::power(cosFalloff, exponent + 1);
    return flux;
}

}  // namespace

void Spotlight::setCosines(float hotspot, float falloff) {
    _cosHotspot = hotspot;
    _cosFalloff = falloff;
    _falloffAngle = single::arcCosine(std::min(hotspot, falloff));
    _exponent = single::logarithm(0.5) / single::logarithm(hotspot);
    _fluxFactor = hotspot <= narrowest ? coneFlux(_exponent, falloff) : 0;
}

// The comparisons are such that a NaN becomes the lower limit.

void Spotlight::setHotspotCosine(float cosine) { setCosines(cosine > widest ? cosine : widest, _cosFalloff); }

void Spotlight::setFalloffCosine(float cosine) {
    setCosines(_cosHotspot, cosine > 0 ? std::min(cosine, narrowest) : 0);
}

void SpotlightPersistant::save(Ov::RnStream& stream) {
    const Spotlight& spot = data();
    stream << spot.candela << spot._cosHotspot << spot._cosFalloff;
}

bool SpotlightPersistant::load(Ov::RnStream& stream, int, const wchar_t*, const wchar_t*) {
    float candela = 0;
    float hotspot = 0;
    float falloff = 0;
    stream >> candela >> hotspot >> falloff;
    data().candela = candela;
    data().setCosines(hotspot, falloff);
    return true;
}

}  // namespace OvPhotometrics
