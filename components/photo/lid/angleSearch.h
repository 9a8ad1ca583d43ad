#pragma once

#include <algorithm>

namespace OvPhotometrics {

/// Index of the last of n ascending angles that is at most `angle`: 0 when all are above it, -1 when there are
/// none, the last for a NaN.
inline int lastAtMost(const float* angles, int n, float angle) {
    if (n < 2) return n - 1;
    const float first = angles[0];
    const float last = angles[n - 1];
    if (!(angle < last)) return n - 1;
    if (angle < first) return 0;

    // Most grids are even: guess, look at the neighbours, and search only when they are not it.
    const float guess = (angle - first) / (last - first) * static_cast<float>(n - 1);
    int k = guess > 0 ? std::min(static_cast<int>(guess), n - 2) : 0;
    if (angles[k] > angle)
        --k;  // k was above 0: the first angle is not above
    else if (angles[k + 1] <= angle)
        ++k;  // k + 1 was below n - 1: the last angle is above
    if (angles[k] <= angle && angle < angles[k + 1]) return k;
    return static_cast<int>(std::upper_bound(angles, angles + n, angle) - angles) - 1;
}

/// The smallest step from one to the next of `count` angles, `angle(k)` each, at most `widest`.
template <class Angle>
float smallestStep(int count, float widest, Angle angle) {
    for (int k = 1; k < count; ++k) widest = std::min(widest, angle(k) - angle(k - 1));
    return widest;
}

}  // namespace OvPhotometrics
