#include <benchmark/benchmark.h>

#include <charconv>
#include <cmath>
#include <cstdio>
#include <map>

#include "bench/data.h"
#include "components/photo/ies/photoWebIES.h"
#include "components/photo/lid/component.h"
#include "components/photo/lid/registration.h"
#include "components/photo/lid/webDistribution.h"
#include "components/photo/naturallight/daylightData.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/devices.h"

// Ours beside a floor in the same run; the ratios are printed at the end.

namespace {

using namespace OvPhotometrics;

constexpr std::size_t directionCount = 65536;

struct File {
    std::string text;
    std::size_t numbers;  // where its numbers start
};

const File& file(bool large) {
    static const auto make = [](int vertical, int horizontal) {
        std::string text = bench::iesText(vertical, horizontal, true);
        const std::size_t numbers = text.find("TILT=NONE\n") + 10;
        return File{std::move(text), numbers};
    };
    static const File small = make(73, 37);
    static const File big = make(361, 721);
    return large ? big : small;
}

RnRef<Ov::RnPhotoWebData> import(const std::string& text) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(text);
    const auto object = immortal<IESBuilder>().import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"bench", nullptr);
    return Ov::rnCast<Ov::RnPhotoWebData>(object.get());
}

const RnRef<Ov::RnPhotoWebData>& fullWeb() {
    static const auto web = import(bench::iesText(73, 37, false));
    return web;
}

void importIes(benchmark::State& state) {
    const File& input = file(state.range(0) != 0);
    for (auto _ : state) benchmark::DoNotOptimize(import(input.text)->getLumens());
    state.SetBytesProcessed(static_cast<std::int64_t>(input.text.size()) * state.iterations());
}

/// A bare loop that converts every number of the same bytes.
void importFloor(benchmark::State& state) {
    const File& input = file(state.range(0) != 0);
    for (auto _ : state) {
        const char* p = input.text.data() + input.numbers;
        const char* const end = input.text.data() + input.text.size();
        float sum = 0;
        while (true) {
            while (p != end && (*p == ' ' || *p == '\n')) ++p;
            if (p == end) break;
            float value;
            p = std::from_chars(p, end, value).ptr;
            sum += value;
        }
        benchmark::DoNotOptimize(sum);
    }
    state.SetBytesProcessed(static_cast<std::int64_t>(input.text.size()) * state.iterations());
}

/// Sums an answer over the random directions; time is that of one.
template <class Ask>
void askAll(benchmark::State& state, Ask ask) {
    const auto directions = bench::directions(directionCount);
    for (auto _ : state) {
        float sum = 0;
        for (const bench::Direction& d : directions) sum += ask(d);
        benchmark::DoNotOptimize(sum);
    }
    state.counters["each"] =
        benchmark::Counter(static_cast<double>(directionCount),
                           benchmark::Counter::kIsIterationInvariantRate | benchmark::Counter::kInvert);
}

void getIntensity(benchmark::State& state) {
    const Ov::RnPhotoWebData& web = *fullWeb();
    askAll(state, [&](bench::Direction d) { return web.getIntensity(d.theta, d.psi); });
}

/// The least that a bicubic lookup costs: inlined, single precision, an even grid known to close at 360 degrees.
class BareGrid {
public:
    explicit BareGrid(const Ov::RnPhotoWebData& web)
        : _columns(web.getThetaCount()),
          _rows(web.getPsiCount()),
          _perTheta(static_cast<float>(_columns - 1) / pi),
          _perPsi(static_cast<float>(_rows) / twoPi) {
        for (int j = 0; j < _rows; ++j)
            for (int i = 0; i < _columns; ++i) _values.push_back(web.getCandela(j, i));
    }

    float operator()(bench::Direction d) const {
        const float x = d.theta * _perTheta;
        const float y = d.psi * _perPsi;
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

void intensityFloor(benchmark::State& state) {
    const BareGrid grid(*fullWeb());
    askAll(state, grid);
}

void intensityAtUnit(benchmark::State& state) {
    const auto light = makeWebDistribution(*fullWeb());
    std::vector<GeVector3<float>> directions;
    for (const bench::Direction& d : bench::directions(directionCount))
        directions.push_back(
            {std::sin(d.theta) * std::cos(d.psi), std::sin(d.theta) * std::sin(d.psi), std::cos(d.theta)});
    std::size_t next = 0;
    askAll(state, [&](bench::Direction) { return light->intensityAtUnit(directions[next++ % directionCount]); });
}

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

BENCHMARK(importIes)->Arg(0)->Arg(1);
BENCHMARK(importFloor)->Arg(0)->Arg(1);
BENCHMARK(getIntensity);
BENCHMARK(intensityFloor);
BENCHMARK(intensityAtUnit);
BENCHMARK(daylightPass);
BENCHMARK(skyIlluminance)->Arg(0)->Arg(1)->Arg(2);
BENCHMARK(skyFloor);
BENCHMARK(expFloor);

/// Keeps the times of a run (the medians, where runs are repeated) and prints ours over the floor's.
class RatioReporter : public benchmark::ConsoleReporter {
public:
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const Run& run : runs)
            if (run.aggregate_name.empty() || run.aggregate_name == "median")
                _seconds[run.run_name.str()] = run.GetAdjustedCPUTime();
        ConsoleReporter::ReportRuns(runs);
    }

    void printRatios() {
        std::puts("\nratio                                             measured   wanted");
        print("import 73 x 37, rate over from_chars", "importFloor/0", "importIes/0", "");
        print("import 361 x 721, rate over from_chars", "importFloor/1", "importIes/1", "0.5 at least");
        print("getIntensity 73 x 37, time over bare lookup", "getIntensity", "intensityFloor", "3.5 at most");
        print("sky illuminance, time over 4096 acos and exp", "skyIlluminance/0", "skyFloor", "1.4 at most");
        print("sky illuminance, time over 4096 exp", "skyIlluminance/0", "expFloor", "3.9 at most");
        print("daylight pass, time over 4096 exp", "daylightPass", "expFloor", "0.05 at most");
    }

private:
    void print(const char* what, const char* above, const char* below, const char* wanted) {
        if (_seconds.contains(above) && _seconds.contains(below))
            std::printf("%-48s %9.2f   %s\n", what, _seconds[above] / _seconds[below], wanted);
    }

    std::map<std::string, double> _seconds;
};

}  // namespace

int main(int argc, char** argv) {
    registerBuilders();
    Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager())->addRegistry(lidComponent());
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
    RatioReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    reporter.printRatios();
}
