#pragma once

#include <cmath>

#include "host/base/exBase.h"

namespace Ov {

/// A vector or direction (x, y, z).
template <class T>
struct GeVector3 {
    /// @{
    /// Along the axes.
    T x{};
    T y{};
    T z{};
    /// @}

    /// The Euclidean length.
    T length() const { return std::sqrt(x * x + y * y + z * z); }

    /// Scales to length 1 by the reciprocal of the length. A length of 0 raises the assertion "len > 0" with the
    /// source line given (the two callers of the host's inline file, 496 and 505, differ in nothing else).
    GeVector3& normalize(int line = 496) {
        const T len = length();
        if (len == 0) Assertions::throwAssertionFailed("len > 0", "primitives/geVector3.inline", line);
        const T scale = T(1) / len;
        x *= scale;
        y *= scale;
        z *= scale;
        return *this;
    }

    /// A copy of length 1; the assertion as for `normalize`.
    GeVector3 normalized() const {
        GeVector3 result = *this;
        return result.normalize(505);
    }

    /// Whether all components are equal.
    friend bool operator==(const GeVector3&, const GeVector3&) = default;
};

}  // namespace Ov
