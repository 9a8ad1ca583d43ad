#pragma once

#include <cstdint>
#include <span>

#include "ovphoto/intensityDist.h"

// Intensities towards many directions at once, in candela:
//
//     std::vector<Ov::GeVector3<float>> directions = ...;
//     std::vector<float> candela(directions.size());
//     OvPhotometrics::intensitiesAt(light.get(), directions, candela);

namespace Ov {

/// How directions are given, and in which frame: as the operation of RnIntensityDist named beside takes them.
enum class DirectionForm : std::int32_t {
    angles = 0,            ///< `intensity`: theta and psi, radians, host frame
    vectors = 1,           ///< `intensityAt`: x, y and z of any length but 0, host frame
    unitVectors = 2,       ///< `intensityAtUnit`: x, y and z of length 1, host frame
    localAngles = 3,       ///< `localIntensity`: theta and psi, radians, the light's own frame
    localVectors = 4,      ///< `localIntensityAt`: x, y and z of any length but 0, the light's own frame
    localUnitVectors = 5,  ///< `localIntensityAtUnit`: x, y and z of length 1, the light's own frame
};

/// A distribution that answers for many directions faster than one after another; web distributions of the module do.
/// Whoever asks uses the functions below, which know what to do with others.
class RnManyIntensities : public RnCastable {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x7c1e9f23, 0x4a5b11ef, 0x9c6e0b62, 0x5d83a4f7};

    /// What the single operation answers to each of `count` directions, bit for bit. `directions` holds two floats
    /// (angles) or three (vectors) for each, one direction after another; `candela` takes `count` floats and may not
    /// overlap them. False, and nothing has been written, where the single operation has to be asked, as for a form
    /// that is none of those above. A zero vector raises the assertion that the single operation raises; what has been
    /// written by then is not to be used.
    virtual bool getIntensities(DirectionForm form, const float* directions, std::int64_t count,
                                float* candela) const = 0;
};

}  // namespace Ov

namespace OvPhotometrics {

using Ov::DirectionForm;

/// A direction by angles in radians.
struct DirectionAngles {
    /// @{
    /// From +Z, and around Z from +X towards +Y.
    float theta = 0;
    float psi = 0;
    /// @}
};

static_assert(sizeof(DirectionAngles) == 2 * sizeof(float));
static_assert(sizeof(Ov::GeVector3<float>) == 3 * sizeof(float));

/// @cond
namespace detail {

using Light = Ov::RnIntensityDist;

inline void askAngles(const Light& light, float (Light::*ask)(float, float) const, const float* angles,
                      std::int64_t count, float* candela) {
    for (std::int64_t k = 0; k < count; ++k) candela[k] = (light.*ask)(angles[2 * k], angles[2 * k + 1]);
}

inline void askVectors(const Light& light, float (Light::*ask)(const Ov::GeVector3<float>&) const,
                       const float* vectors, std::int64_t count, float* candela) {
    for (std::int64_t k = 0; k < count; ++k)
        candela[k] = (light.*ask)({vectors[3 * k], vectors[3 * k + 1], vectors[3 * k + 2]});
}

/// Asks for one after another. False for an unknown form.
inline bool askEach(const Light& light, DirectionForm form, const float* directions, std::int64_t count,
                    float* candela) {
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

}  // namespace detail
/// @endcond

/// Intensities of any distribution towards `count` directions, as RnManyIntensities takes and gives them; a distribution
/// that does not answer it is asked for each. Both pointers may be null when `count` is 0. False, and nothing has been
/// written, when `light` is null or no distribution, a pointer is null, the count is below 0 or the form is none.
inline bool getIntensities(Ov::RnCastable* light, DirectionForm form, const float* directions, std::int64_t count,
                           float* candela) {
    const auto distribution = Ov::rnQuery<Ov::RnIntensityDist>(light);
    if (!distribution || count < 0 || (count > 0 && (!directions || !candela))) return false;
    const auto many = Ov::rnQuery<Ov::RnManyIntensities>(light);
    if (many && many->getIntensities(form, directions, count, candela)) return true;
    return detail::askEach(*distribution, form, directions, count, candela);
}

/// @cond
namespace detail {

template <class Direction>
bool intensities(Ov::RnCastable* light, DirectionForm form, std::span<const Direction> directions,
                 std::span<float> candela) {
    if (candela.size() < directions.size()) return false;
    return getIntensities(light, form, reinterpret_cast<const float*>(directions.data()),
                          static_cast<std::int64_t>(directions.size()), candela.data());
}

}  // namespace detail
/// @endcond

// False, and nothing has been written, as above, and when there are fewer places in `candela` than directions.

/// @{
/// Host frame: towards angles, directions of any length but 0, unit directions.
inline bool intensities(Ov::RnCastable* light, std::span<const DirectionAngles> directions,
                        std::span<float> candela) {
    return detail::intensities(light, DirectionForm::angles, directions, candela);
}
inline bool intensitiesAt(Ov::RnCastable* light, std::span<const Ov::GeVector3<float>> directions,
                          std::span<float> candela) {
    return detail::intensities(light, DirectionForm::vectors, directions, candela);
}
inline bool intensitiesAtUnit(Ov::RnCastable* light, std::span<const Ov::GeVector3<float>> directions,
                              std::span<float> candela) {
    return detail::intensities(light, DirectionForm::unitVectors, directions, candela);
}
/// @}

/// @{
/// The same in the light's own frame.
inline bool localIntensities(Ov::RnCastable* light, std::span<const DirectionAngles> directions,
                             std::span<float> candela) {
    return detail::intensities(light, DirectionForm::localAngles, directions, candela);
}
inline bool localIntensitiesAt(Ov::RnCastable* light, std::span<const Ov::GeVector3<float>> directions,
                               std::span<float> candela) {
    return detail::intensities(light, DirectionForm::localVectors, directions, candela);
}
inline bool localIntensitiesAtUnit(Ov::RnCastable* light, std::span<const Ov::GeVector3<float>> directions,
                                   std::span<float> candela) {
    return detail::intensities(light, DirectionForm::localUnitVectors, directions, candela);
}
/// @}

}  // namespace OvPhotometrics
