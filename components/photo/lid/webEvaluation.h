#pragma once

#include <algorithm>
#include <limits>

#include "components/photo/lid/photoWeb.h"

// Intensities between the samples of a web: Catmull-Rom interpolation in both directions.

namespace OvPhotometrics {

/// The cubic through p1 (t = 0) and p2 (t = 1) whose slopes there are half the differences of the neighbours
/// (Catmull and Rom 1974): differences of neighbours in single precision, the rest in double, rounded once.
inline float catmullRom(const float p[4], float t) {
    const double p0 = p[0];
    const double p1 = p[1];
    const double p2 = p[2];
    const double p3 = p[3];
    const double d30 = p[3] - p[0];
    const double d12 = p[1] - p[2];
    const double d20 = p[2] - p[0];
    const double x = t;
    return static_cast<float>(
        p1 + x * (d20 * 0.5 + x * ((2 * p2 - 0.5 * p3 - 2.5 * p1 + p0) + x * (d30 * 0.5 + d12 * 1.5))));
}

namespace detail {

/// Where `a` lies between a0 and a0 + width, from 0 to 1; 0 when they do not ascend.
inline float fraction(float a, float a0, float width) { return width > 0 ? (a - a0) / width : 0; }

/// The plane of the stored range that psi stands for. Every step is worked out, and chosen or not: directions are
/// random, and branches on them slow.
inline float foldPsi(float psi, PhotoWebSymmetry symmetry) {
    const bool quarter = symmetry == PhotoWebSymmetry::Quarter;
    const bool half = symmetry == PhotoWebSymmetry::Half || quarter;
    const float above = psi + twoPi;
    psi = psi < 0 ? above : psi;
    const float below = psi - twoPi;
    psi = psi >= twoPi ? below : psi;
    const float acrossHalf = twoPi - psi;
    psi = half && psi > pi ? acrossHalf : psi;
    const float acrossQuarter = pi - psi;
    return quarter && psi > halfPi ? acrossQuarter : psi;
}

/// What an interpolation gives as light: 0 where it swings below, the largest number where that is exceeded.
inline float asLight(float value) { return value > 0 ? std::min(value, std::numeric_limits<float>::max()) : 0; }

}  // namespace detail

/// Relative intensity of `web` towards (theta, psi). The web is asked through its own operations only, so that a
/// class which overrides one of them gets its own; for a final class they resolve at compile time.
template <class Web>
float evaluateWeb(const Web& web, float theta, float psi) {
    // Dark: no direction, above the first and below the last vertical angle, and a web without values.
    if (theta != theta || psi != psi) return 0;
    theta = theta < 0 ? 0 : theta > pi ? pi : theta;
    const AngleRange thetas = web.getThetaRange();
    if (theta < thetas.first || theta > thetas.last) return 0;
    const int nthetas = web.getThetaCount();
    const int npsis = web.getPsiCount();
    if (nthetas <= 0 || npsis <= 0) return 0;

    // The column at or before theta, and how far theta lies on the way to the next.
    const int i = web.findTheta(theta);
    float u = 0;
    if (i < nthetas - 1) {
        const float t0 = web.getTheta(i);
        u = detail::fraction(theta, t0, web.getTheta(i + 1) - t0);
    }

    // Four values around theta are enough where all planes are the same.
    const IndexRange columns{i - 1, i + 2};
    float block[16] = {};
    const PhotoWebSymmetry symmetry = web.getSymmetry();
    if (symmetry == PhotoWebSymmetry::Axial) {
        web.getCandelaBlock({0, 0}, columns, block);
        return detail::asLight(catmullRom(block, u));
    }

    // The row at or before psi; -1 before the first. Behind the last a truncated web is dark.
    psi = detail::foldPsi(psi, symmetry);
    const AngleRange psis = web.getPsiRange();
    int j = -1;
    if (psi > psis.last) {
        if (web.isPsiTruncated()) return 0;
        j = npsis - 1;
    } else if (psi >= psis.first) {
        j = web.findPsi(psi);
    }

    // How far psi lies on the way to the next row. Behind the last that is the first of a closed circle; the others go
    // on as wide as the interval before.
    float v = 0;
    if (j < 0) {
        j = 0;
    } else {
        const float p0 = web.getPsi(j);
        const float width = j < npsis - 1                        ? web.getPsi(j + 1) - p0
                            : symmetry == PhotoWebSymmetry::Full ? twoPi - (psis.last - psis.first)
                                                                 : p0 - web.getPsi(j - 1);
        v = detail::fraction(psi, p0, width);
    }

    // Interpolate along theta in four rows, then along psi.
    web.getCandelaBlock({j - 1, j + 2}, columns, block);
    float rows[4];
    for (std::size_t k = 0; k < 4; ++k) rows[k] = catmullRom(block + 4 * k, u);
    return detail::asLight(catmullRom(rows, v));
}

}  // namespace OvPhotometrics
