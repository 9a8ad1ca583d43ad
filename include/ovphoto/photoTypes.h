#pragma once

#include <cstdint>

namespace Ov {

/// How the stored horizontal angles of a web or distribution stand for the whole circle.
enum class PhotoWebSymmetry : std::int32_t {
    Full = 0,     ///< stored as is; the circle closes from the last psi back to the first plus 2 pi
    Half = 1,     ///< psi 0 to pi, mirrored at that plane
    Quarter = 2,  ///< psi 0 to pi/2, mirrored at both planes
    Axial = 3     ///< one psi, the same for all directions around the axis
};

/// Angles {first, last} in radians.
struct AngleRange {
    /// @{
    /// Both ends belong to the range.
    float first = 0;
    float last = 0;
    /// @}
};

/// Indices {first, last}, both inclusive.
struct IndexRange {
    /// @{
    /// Both ends belong to the range.
    std::int32_t first = 0;
    std::int32_t last = 0;
    /// @}
};

}  // namespace Ov
