#include "components/photo/lid/fluxIntegral.h"

#include <array>
#include <cmath>
#include <vector>

#include "components/photo/lid/angles.h"

namespace OvPhotometrics {

namespace {

std::size_t count(int n) { return static_cast<std::size_t>(n); }

/// The flux integral over theta of many rows on one list of angles: the sines serve all rows.
class ThetaIntegral {
public:
    ThetaIntegral(int n, const float* angles)
        : _n(n), _angles(angles), _steps(n < 30 && n > 1 ? (n + 28) / (n - 1) : 1) {
        if (n < 2) return;
        _sines.reserve(count(n - 1) * count(_steps));
        for (int k = 1; k < n; ++k)
            if (subdivides())
                addSteps(k);
            else
                addSine((angles[k] + angles[k - 1]) / 2);
    }

    /// The integrals of `Rows` rows, one after another in memory. The sums of a row are a chain of dependent
    /// steps; several rows at once keep the machine busy.
    template <int Rows>
    std::array<float, Rows> of(const float* values) const {
        if (_n < 2) return {};
        return subdivides() ? sumOfSteps<Rows>(values) : sumOfIntervals<Rows>(values);
    }

private:
    bool subdivides() const { return _n < 30; }
    void addSine(float angle) { _sines.push_back(std::sin(static_cast<double>(angle))); }
    float stepOf(int k) const { return (_angles[k] - _angles[k - 1]) / static_cast<float>(_steps); }

    void addSteps(int k) {
        const float da = stepOf(k);
        float a = _angles[k - 1];
        for (int step = 0; step < _steps; ++step, a += da) addSine((a + da + a) * 0.5f);
    }

    template <int Rows>
    std::array<float, Rows> sumOfIntervals(const float* values) const {
        std::array<float, Rows> sums{};
        for (int k = 1; k < _n; ++k) {
            const double sine = _sines[count(k - 1)];
            const float da = _angles[k] - _angles[k - 1];
            for (int r = 0; r < Rows; ++r) {
                const float* v = values + static_cast<std::ptrdiff_t>(r) * _n + k;
                float& sum = sums[count(r)];
                sum = static_cast<float>(sum + sine * ((v[0] + v[-1]) * da));
            }
        }
        for (float& sum : sums) sum *= 0.5f;
        return sums;
    }

    template <int Rows>
    std::array<float, Rows> sumOfSteps(const float* values) const {
        std::array<float, Rows> totals{};
        for (int r = 0; r < Rows; ++r, values += _n) totals[count(r)] = sumOfSteps(values);
        return totals;
    }

    float sumOfSteps(const float* values) const {
        float total = 0;
        const double* sine = _sines.data();
        for (int k = 1; k < _n; ++k) {
            const float dv = (values[k] - values[k - 1]) / static_cast<float>(_steps);
            float v = values[k - 1];
            float sum = 0;
            for (int step = 0; step < _steps; ++step, v += dv)
                sum = static_cast<float>(sum + *sine++ * (v + dv + v));
            total += stepOf(k) * sum;
        }
        return total * 0.5f;
    }

    int _n;
    const float* _angles;
    int _steps;  // equal parts that an interval of a coarse list is cut into
    std::vector<double> _sines;
};

std::vector<float> integrateRows(const WebGrid& grid) {
    constexpr int together = 8;
    const ThetaIntegral integral(grid.nthetas, grid.thetas);
    std::vector<float> rows;
    rows.reserve(count(grid.npsis));
    const auto add = [&](const auto& sums) { rows.insert(rows.end(), sums.begin(), sums.end()); };
    int j = 0;
    const auto row = [&] { return grid.values + count(j) * count(grid.nthetas); };
    for (; j + together <= grid.npsis; j += together) add(integral.of<together>(row()));
    for (; j < grid.npsis; ++j) add(integral.of<1>(row()));
    return rows;
}

}  // namespace

float photoWebIntegrate(int n, const float* angles, const float* values) {
    return ThetaIntegral(n, angles).of<1>(values)[0];
}

float fluxOf(const WebGrid& grid, float maxCandela) {
    // Trapezoids between the stored planes.
    const std::vector<float> rows = integrateRows(grid);
    const float first = rows.front();
    const float last = rows.back();
    float sum = 0;
    for (int j = 1; j < grid.npsis; ++j)
        sum += (rows[count(j)] + rows[count(j - 1)]) * (grid.psis[j] - grid.psis[j - 1]);

    // What lies behind the last plane, and as many parts as the symmetry repeats.
    const float lastPsi = grid.psis[grid.npsis - 1];
    switch (grid.symmetry) {
        case PhotoWebSymmetry::Full:
            if (!grid.psiTruncated) sum += ((grid.psis[0] + twoPi) - lastPsi) * (last + first);
            break;
        case PhotoWebSymmetry::Half:
            if (!grid.psiTruncated) sum += 2 * last * (pi - lastPsi);
            sum = 2 * sum;
            break;
        case PhotoWebSymmetry::Quarter:
            if (!grid.psiTruncated) sum += 2 * last * (halfPi - lastPsi);
            sum = 4 * sum;
            break;
        case PhotoWebSymmetry::Axial:
            sum = (first + first) * twoPi;
            break;
    }
    return sum * 0.5f * maxCandela;
}

}  // namespace OvPhotometrics
