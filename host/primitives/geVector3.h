#pragma once

#include <cmath>
#include <limits>

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

    /// The Euclidean length. It is right where `measurable` changes nothing.
    T length() const { return std::sqrt(squaredLength()); }

    /// A vector of the same direction whose length can be taken: this one, or where the sum of its squares
    /// overflows or falls out of the normal range, and so loses digits, this one times a power of two.
    GeVector3 measurable() const {
        using Limits = std::numeric_limits<T>;
        const T square = squaredLength();
        if (square >= Limits::min() && square <= Limits::max()) return *this;
        // Four fifths of the exponents: the squares of the largest and of the smallest numbers come into the range.
        constexpr int shift = Limits::max_exponent * 4 / 5;
        const T factor = std::ldexp(T(1), square < 1 ? shift : -shift);
        return {x * factor, y * factor, z * factor};
    }

    /// Scales to length 1 by the reciprocal of the length. A length of 0 raises the assertion "len > 0" with the
    /// source line given (the two callers of the host's inline file, 496 and 505, differ in nothing else).
    GeVector3& normalize(int line = 496) {
        *this = measurable();
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

private:
    T squaredLength() const { return x * x + y * y + z * z; }
};

}  // namespace Ov
