#pragma once

#include <array>
#include <cstddef>

#include "host/primitives/geVector3.h"

namespace Ov {

/// A 3 by 3 matrix, its nine values stored column after column: the product with (x, y, z) is
///
///     x' = m0 x + m3 y + m6 z
///     y' = m1 x + m4 y + m7 z
///     z' = m2 x + m5 y + m8 z
///
/// Constructor and accessors take and give the nine values in that storage order.
template <class T>
class GeLinearMatrix3 {
public:
    /// The identity.
    constexpr GeLinearMatrix3() { setIdentity(); }
    /// The nine values in storage order.
    explicit constexpr GeLinearMatrix3(const std::array<T, 9>& values) : _m(values) {}

    /// @{
    /// Set or give the values, in storage order.
    constexpr void setIdentity() { _m = {1, 0, 0, 0, 1, 0, 0, 0, 1}; }
    constexpr void set(const std::array<T, 9>& values) { _m = values; }
    constexpr const std::array<T, 9>& values() const { return _m; }
    constexpr T operator[](std::size_t i) const { return _m[i]; }
    /// @}

    /// Rows and columns exchanged: for a rotation, the one back.
    constexpr GeLinearMatrix3 computeTranspose() const {
        return GeLinearMatrix3({_m[0], _m[3], _m[6], _m[1], _m[4], _m[7], _m[2], _m[5], _m[8]});
    }

    /// The product with a vector.
    friend constexpr GeVector3<T> operator*(const GeLinearMatrix3& m, const GeVector3<T>& v) {
        return {m[0] * v.x + m[3] * v.y + m[6] * v.z, m[1] * v.x + m[4] * v.y + m[7] * v.z,
                m[2] * v.x + m[5] * v.y + m[8] * v.z};
    }
    /// Whether all values are equal.
    friend constexpr bool operator==(const GeLinearMatrix3&, const GeLinearMatrix3&) = default;

private:
    std::array<T, 9> _m{};
};

}  // namespace Ov
