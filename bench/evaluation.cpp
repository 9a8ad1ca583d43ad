#include <algorithm>
#include <cmath>

#include "bench/bench.h"
#include "components/photo/files/webDistribution.h"
#include "ovphoto/intensities.h"

// Intensities of a web towards random directions, one by one and many at once, beside a bare lookup. Times are
// those of one direction.

namespace {

using OvPhotometrics::DirectionForm;

constexpr std::size_t directionCount = 65536;

/// Full webs; the first has the size that makers publish.
constexpr int sizes[][2] = {{73, 37}, {19, 9}, {181, 91}, {361, 181}, {721, 721}};

const Ov::RnRef<Ov::RnPhotoWebData>& web(std::int64_t size) {
    static Ov::RnRef<Ov::RnPhotoWebData> webs[std::size(sizes)];
    auto& made = webs[size];
    if (!made) made = bench::webOf(sizes[size][0], sizes[size][1]);
    return made;
}

const std::vector<float>& angles() {
    static const auto made = bench::randomAngles(directionCount);
    return made;
}

const std::vector<float>& vectors() {
    static const auto made = [] {
        std::vector<float> all;
        for (std::size_t k = 0; k < angles().size(); k += 2) {
            const float theta = angles()[k];
            const float psi = angles()[k + 1];
            all.insert(all.end(),
                       {std::sin(theta) * std::cos(psi), std::sin(theta) * std::sin(psi), std::cos(theta)});
        }
        return all;
    }();
    return made;
}

/// Sums an answer over directions of `floats` numbers each.
template <class Ask>
void askEach(benchmark::State& state, const std::vector<float>& directions, std::size_t floats, Ask ask) {
    for (auto _ : state) {
        float sum = 0;
        for (std::size_t k = 0; k < directions.size(); k += floats) sum += ask(&directions[k]);
        benchmark::DoNotOptimize(sum);
    }
    bench::countEach(state, directionCount);
}

void askMany(benchmark::State& state, DirectionForm form, const std::vector<float>& directions) {
    const auto light = OvPhotometrics::makeWebDistribution(*web(state.range(0)));
    std::vector<float> candela(directionCount);
    for (auto _ : state) {
        OvPhotometrics::getIntensities(light.get(), form, directions.data(), directionCount, candela.data());
        benchmark::ClobberMemory();
    }
    bench::countEach(state, directionCount);
}

void getIntensity(benchmark::State& state) {
    const Ov::RnPhotoWebData& asked = *web(state.range(0));
    askEach(state, angles(), 2, [&](const float* d) { return asked.getIntensity(d[0], d[1]); });
}

void manyAngles(benchmark::State& state) { askMany(state, DirectionForm::localAngles, angles()); }

void intensityAtUnit(benchmark::State& state) {
    const auto light = OvPhotometrics::makeWebDistribution(*web(0));
    askEach(state, vectors(), 3, [&](const float* d) { return light->intensityAtUnit({d[0], d[1], d[2]}); });
}

void manyVectors(benchmark::State& state) { askMany(state, DirectionForm::unitVectors, vectors()); }

/// The least that a bicubic lookup costs: inlined, single precision, an even grid known to close at 360 degrees.
class BareGrid {
public:
    explicit BareGrid(const Ov::RnPhotoWebData& web)
        : _columns(web.getThetaCount()),
          _rows(web.getPsiCount()),
          _perTheta(static_cast<float>(_columns - 1) / OvPhotometrics::pi),
          _perPsi(static_cast<float>(_rows) / OvPhotometrics::twoPi) {
        for (int j = 0; j < _rows; ++j)
            for (int i = 0; i < _columns; ++i) _values.push_back(web.getCandela(j, i));
    }

    float operator()(const float* angles) const {
        const float x = angles[0] * _perTheta;
        const float y = angles[1] * _perPsi;
        const int i = std::min(static_cast<int>(x), _columns - 2);
        const int j = std::min(static_cast<int>(y), _rows - 1);
        const float u = x - static_cast<float>(i);
        const float v = y - static_cast<float>(j);
        float rows[4];
        for (int k = 0; k < 4; ++k) {
            int row = j - 1 + k;
            row += row < 0 ? _rows : row >= _rows ? -_rows : 0;
            const float* p = _values.data() + row * _columns;
            rows[k] = cubic(p[std::max(i - 1, 0)], p[i], p[i + 1], p[std::min(i + 2, _columns - 1)], u);
        }
        return std::max(cubic(rows[0], rows[1], rows[2], rows[3], v), 0.0f);
    }

private:
    static float cubic(float p0, float p1, float p2, float p3, float t) {
        return p1 + 0.5f * t * (p2 - p0 + t * (2 * p0 - 5 * p1 + 4 * p2 - p3 + t * (3 * (p1 - p2) + p3 - p0)));
    }

    int _columns, _rows;
    float _perTheta, _perPsi;
    std::vector<float> _values;
};

void intensityFloor(benchmark::State& state) { askEach(state, angles(), 2, BareGrid(*web(0))); }

/// What a vector costs before the lookup: an arc cosine and an arc tangent.
void vectorFloor(benchmark::State& state) {
    askEach(state, vectors(), 3, [](const float* d) {
        return static_cast<float>(std::acos(static_cast<double>(d[2])) +
                                  std::atan2(static_cast<double>(d[1]), static_cast<double>(d[0])));
    });
}

constexpr int lastSize = static_cast<int>(std::size(sizes)) - 1;

BENCHMARK(getIntensity)->DenseRange(0, lastSize);
BENCHMARK(manyAngles)->DenseRange(0, lastSize);
BENCHMARK(intensityFloor);
BENCHMARK(intensityAtUnit);
BENCHMARK(manyVectors)->Arg(0);
BENCHMARK(vectorFloor);

const bool listed = bench::addRatios({
    {.what = "getIntensity 73 x 37, time over bare lookup",
     .ours = "getIntensity/0",
     .floor = "intensityFloor",
     .atMost = 3.5},
    {.what = "many angles 73 x 37, time over bare lookup",
     .ours = "manyAngles/0",
     .floor = "intensityFloor",
     .atMost = 1.5},
    {.what = "many unit vectors 73 x 37, time over acos and atan2",
     .ours = "manyVectors/0",
     .floor = "vectorFloor"},
    {.what = "intensityAtUnit 73 x 37, time over acos and atan2",
     .ours = "intensityAtUnit",
     .floor = "vectorFloor"},
    {.what = "getIntensity 721 x 721, time over 19 x 9", .ours = "getIntensity/4", .floor = "getIntensity/1"},
    {.what = "many angles 721 x 721, time over 19 x 9", .ours = "manyAngles/4", .floor = "manyAngles/1"},
});

}  // namespace
