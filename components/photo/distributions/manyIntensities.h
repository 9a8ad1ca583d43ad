#pragma once

#include "ovphoto/numberedExports.h"

// Intensities towards many directions, as the numbered export offers them; its contract stands there.

namespace OvPhotometrics {

/// The module's own web distribution, which the module knows by an id of its own.
class ManyIntensities : public Ov::RnWebIntensityDist {
public:
    static constexpr Ov::RnUid iid{0x7c1e9f11, 0x4a5b11ef, 0x9c6e0b62, 0x5d83a4f7};

    /// What the single operations answer, bit for bit. False, and nothing is written, where they have to be asked.
    virtual bool intensities(DirectionForm form, const float* directions, std::size_t count, float* out) const = 0;
};

bool getIntensities(Ov::RnCastable* light, DirectionForm form, const float* directions, std::int64_t count,
                    float* candela);

}  // namespace OvPhotometrics
