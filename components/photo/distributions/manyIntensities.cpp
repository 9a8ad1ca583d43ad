#include "components/photo/distributions/manyIntensities.h"

namespace OvPhotometrics {

namespace {

using Vector = Ov::GeVector3<float>;
using Light = Ov::RnIntensityDist;

void askAngles(const Light& light, float (Light::*ask)(float, float) const, const float* angles,
               std::int64_t count, float* candela) {
    for (std::int64_t k = 0; k < count; ++k) candela[k] = (light.*ask)(angles[2 * k], angles[2 * k + 1]);
}

void askVectors(const Light& light, float (Light::*ask)(const Vector&) const, const float* vectors,
                std::int64_t count, float* candela) {
    for (std::int64_t k = 0; k < count; ++k)
        candela[k] = (light.*ask)({vectors[3 * k], vectors[3 * k + 1], vectors[3 * k + 2]});
}

/// Asks for one after another. False for an unknown form.
bool askEach(const Light& light, DirectionForm form, const float* directions, std::int64_t count, float* candela) {
    switch (form) {
        case DirectionForm::angles:
            askAngles(light, &Light::intensity, directions, count, candela);
            return true;
        case DirectionForm::vectors:
            askVectors(light, &Light::intensityAt, directions, count, candela);
            return true;
        case DirectionForm::unitVectors:
            askVectors(light, &Light::intensityAtUnit, directions, count, candela);
            return true;
        case DirectionForm::localAngles:
            askAngles(light, &Light::localIntensity, directions, count, candela);
            return true;
        case DirectionForm::localVectors:
            askVectors(light, &Light::localIntensityAt, directions, count, candela);
            return true;
        case DirectionForm::localUnitVectors:
            askVectors(light, &Light::localIntensityAtUnit, directions, count, candela);
            return true;
    }
    return false;
}

}  // namespace

bool getIntensities(Ov::RnCastable* light, DirectionForm form, const float* directions, std::int64_t count,
                    float* candela) {
    const auto distribution = Ov::rnQuery<Light>(light);
    if (!distribution || count < 0 || (count > 0 && (!directions || !candela))) return false;
    const auto own = Ov::rnQuery<ManyIntensities>(light);
    if (own && own->intensities(form, directions, static_cast<std::size_t>(count), candela)) return true;
    return askEach(*distribution, form, directions, count, candela);
}

}  // namespace OvPhotometrics
