#pragma once

#include <cstddef>

#include "ovphoto/photoTypes.h"

namespace OvPhotometrics {

/// The grid of a web as it lies in memory: ascending angles, values one psi row after another.
struct WebGrid {
    const float* thetas;
    const float* psis;
    const float* values;
    int nthetas;
    int npsis;
    Ov::PhotoWebSymmetry symmetry;
    bool psiTruncated;
};

/// Kinds of machines, from narrow to wide instructions; a machine has those up to its widest.
enum class Instructions { common, avx2, avx512 };

/// Of this machine.
Instructions widestInstructions();

/// What `evaluateWeb` answers, bit for bit, towards `count` directions, a theta and a psi each: many side by side,
/// by instructions that the machine must have.
void evaluateGrid(const WebGrid& grid, const float* angles, std::size_t count, float* out,
                  Instructions instructions = widestInstructions());

}  // namespace OvPhotometrics
