#include <cmath>

#include "bench/bench.h"
#include "components/photo/naturallight/daylightData.h"

// The daylight pass and the light of the sky, beside as many calls of the functions that they need.

namespace {

using OvPhotometrics::DaylightData;

/// One pass from the settings, by a change of the time and a question.
void daylightPass(benchmark::State& state) {
    const auto light = Ov::rnCreate<DaylightData>();
    float hour = 0;
    for (auto _ : state) {
        light->setLocalTime(hour = hour < 23 ? hour + 0.1f : 0);
        benchmark::DoNotOptimize(light->getZenithLuminance());
    }
}

/// A horizontal surface, which faces all samples.
void skyIlluminance(benchmark::State& state) {
    const auto light = Ov::rnCreate<DaylightData>();
    light->setSkyCover(static_cast<float>(state.range(0)) / 2);
    const float up[3] = {0, 0, 1};
    for (auto _ : state) benchmark::DoNotOptimize(light->getSkyIlluminance(up));
}

/// Calls `function` as often as the sky is sampled, with values from 1 to -1.
template <class Function>
void bareLoop(benchmark::State& state, Function function) {
    std::vector<double> values;
    for (int i = 0; i < 4096; ++i) values.push_back(std::cos(i * 3.14159 / 4096));
    for (auto _ : state) {
        double sum = 0;
        for (const double value : values) sum += function(value);
        benchmark::DoNotOptimize(sum);
    }
}

void skyFloor(benchmark::State& state) {
    bareLoop(state, [](double value) { return std::exp(-3 * std::acos(value)); });
}

void expFloor(benchmark::State& state) {
    bareLoop(state, [](double value) { return std::exp(-3 * value); });
}

BENCHMARK(daylightPass);
BENCHMARK(skyIlluminance)->DenseRange(0, 2);
BENCHMARK(skyFloor);
BENCHMARK(expFloor);

const bool listed = bench::addRatios({
    {.what = "sky illuminance, time over 4096 acos and exp",
     .ours = "skyIlluminance/0",
     .floor = "skyFloor",
     .atMost = 1.4},
    {.what = "sky illuminance, time over 4096 exp",
     .ours = "skyIlluminance/0",
     .floor = "expFloor",
     .atMost = 3.9},
    {.what = "daylight pass, time over 4096 exp", .ours = "daylightPass", .floor = "expFloor", .atMost = 0.05},
});

}  // namespace
