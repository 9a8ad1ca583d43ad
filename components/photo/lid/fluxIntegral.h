#pragma once

#include "components/photo/lid/gridEvaluation.h"

// What a light gives off: the integral of its intensity over the sphere.

namespace OvPhotometrics {

/// The integral of v(theta) sin(theta) over the n sampled angles, v linear between them: exact sums are fixed, in
/// single precision around a double sine. 0 for fewer than two angles.
float photoWebIntegrate(int n, const float* angles, const float* values);

/// Flux in lumens of a grid with at least one angle in each direction, its values relative to a peak of `maxCandela`:
/// that integral of each row, and trapezoids between the rows. Throws std::bad_alloc.
float fluxOf(const WebGrid& grid, float maxCandela);

}  // namespace OvPhotometrics
