#pragma once

#include <span>

#include "ovphoto/numberedExports.h"

// Intensities towards many directions at once, in candela, through a loaded module's `getIntensities`, which has
// the contract: each equals the answer of the distribution's own operation. False when `light` is null or no
// distribution, when there are fewer places in `candela` than directions, or when the module is one without the
// function; nothing has been written then.
//
//     const auto functions = OvPhotometrics::numberedFunctions(module);
//     std::vector<Ov::GeVector3<float>> directions = ...;
//     std::vector<float> candela(directions.size());
//     OvPhotometrics::intensitiesAt(functions, light.get(), directions, candela);

namespace OvPhotometrics {

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

template <class Direction>
bool intensities(const NumberedFunctions& functions, Ov::RnCastable* light, DirectionForm form,
                 std::span<const Direction> directions, std::span<float> candela) {
    if (!functions.getIntensities || candela.size() < directions.size()) return false;
    return functions.getIntensities(light, form, reinterpret_cast<const float*>(directions.data()),
                                    static_cast<std::int64_t>(directions.size()), candela.data());
}

}  // namespace detail
/// @endcond

/// @{
/// Host frame: towards angles, directions of any length but 0, unit directions.
inline bool intensities(const NumberedFunctions& functions, Ov::RnCastable* light,
                        std::span<const DirectionAngles> directions, std::span<float> candela) {
    return detail::intensities(functions, light, DirectionForm::angles, directions, candela);
}
inline bool intensitiesAt(const NumberedFunctions& functions, Ov::RnCastable* light,
                          std::span<const Ov::GeVector3<float>> directions, std::span<float> candela) {
    return detail::intensities(functions, light, DirectionForm::vectors, directions, candela);
}
inline bool intensitiesAtUnit(const NumberedFunctions& functions, Ov::RnCastable* light,
                              std::span<const Ov::GeVector3<float>> directions, std::span<float> candela) {
    return detail::intensities(functions, light, DirectionForm::unitVectors, directions, candela);
}
/// @}

/// @{
/// The same in the light's own frame.
inline bool localIntensities(const NumberedFunctions& functions, Ov::RnCastable* light,
                             std::span<const DirectionAngles> directions, std::span<float> candela) {
    return detail::intensities(functions, light, DirectionForm::localAngles, directions, candela);
}
inline bool localIntensitiesAt(const NumberedFunctions& functions, Ov::RnCastable* light,
                               std::span<const Ov::GeVector3<float>> directions, std::span<float> candela) {
    return detail::intensities(functions, light, DirectionForm::localVectors, directions, candela);
}
inline bool localIntensitiesAtUnit(const NumberedFunctions& functions, Ov::RnCastable* light,
                                   std::span<const Ov::GeVector3<float>> directions, std::span<float> candela) {
    return detail::intensities(functions, light, DirectionForm::localUnitVectors, directions, candela);
}
/// @}

}  // namespace OvPhotometrics
