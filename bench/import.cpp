#include <charconv>

#include "bench/bench.h"
#include "components/support/devices.h"
#include "tests/support/plainDevice.h"

// Import of files, everything included, beside a bare loop of std::from_chars over the same bytes.

namespace {

namespace ids = OvPhotometrics::classIds;

struct Input {
    Ov::RnUid classId;
    std::string text;
};

/// IES files as makers publish them and large ones; files of the other formats with angles of whole degrees.
const Input& input(std::int64_t which) {
    static const std::vector<Input> inputs = [] {
        const auto web = bench::webOf(181, 360);
        std::vector<Input> all{{ids::iesWeb, bench::iesText(73, 37, true)},
                               {ids::iesWeb, bench::iesText(361, 721, true)}};
        for (const Ov::RnUid& id : {ids::cibseWeb, ids::nimbWeb, ids::tbtWeb})
            all.push_back({id, bench::fileText(id, *web)});
        return all;
    }();
    return inputs[static_cast<std::size_t>(which)];
}

template <class Device>
void importFrom(benchmark::State& state) {
    const Input& file = input(state.range(0));
    const auto io = Ov::rnCreate<Device>(file.text);
    for (auto _ : state) benchmark::DoNotOptimize(bench::import(file.classId, *io)->getLumens());
    bench::countBytes(state, file.text.size());
}

void import(benchmark::State& state) { importFrom<Ov::RnMemoryBuffer>(state); }
/// From a host's own device, which shows no bytes.
void importPlain(benchmark::State& state) { importFrom<PlainDevice>(state); }

void importFloor(benchmark::State& state) {
    const Input& file = input(state.range(0));
    for (auto _ : state) benchmark::DoNotOptimize(bench::walkNumbers(file.text));
    bench::countBytes(state, file.text.size());
}

/// Whole numbers in fields of four characters.
void importFieldsFloor(benchmark::State& state) {
    const std::string& text = input(state.range(0)).text;
    for (auto _ : state) {
        int sum = 0;
        const char* const end = text.data() + text.size();
        for (const char* p = text.data(); end - p >= 4;) {
            if (*p == '\n') {
                ++p;
                continue;
            }
            const char* const field = p;
            p += 4;
            const char* digits = field;
            while (digits != p && *digits == ' ') ++digits;
            int value = 0;
            std::from_chars(digits, p, value);
            sum += value;
        }
        benchmark::DoNotOptimize(sum);
    }
    bench::countBytes(state, text.size());
}

BENCHMARK(import)->DenseRange(0, 4);
BENCHMARK(importPlain)->DenseRange(1, 4);
BENCHMARK(importFloor)->Arg(0)->Arg(1)->Arg(2)->Arg(4);
BENCHMARK(importFieldsFloor)->Arg(3);

const bool listed = bench::addRatios({
    {.what = "import IES 73 x 37, rate over from_chars", .ours = "import/0", .floor = "importFloor/0"},
    {.what = "import IES 361 x 721, rate over from_chars",
     .ours = "import/1",
     .floor = "importFloor/1",
     .atLeast = 0.5},
    {.what = "import CIBSE 181 x 360, rate over from_chars",
     .ours = "import/2",
     .floor = "importFloor/2",
     .atLeast = 0.4},
    {.what = "import NIMB 181 x 360, rate over from_chars of fields",
     .ours = "import/3",
     .floor = "importFieldsFloor/3",
     .atLeast = 0.4},
    {.what = "import TBT 181 x 360, rate over from_chars",
     .ours = "import/4",
     .floor = "importFloor/4",
     .atLeast = 0.4},
    {.what = "import IES without a window, rate over memory",
     .ours = "importPlain/1",
     .floor = "import/1",
     .atLeast = 0.33},
    {.what = "import CIBSE without a window", .ours = "importPlain/2", .floor = "import/2", .atLeast = 0.33},
    {.what = "import NIMB without a window", .ours = "importPlain/3", .floor = "import/3", .atLeast = 0.33},
    {.what = "import TBT without a window", .ours = "importPlain/4", .floor = "import/4", .atLeast = 0.33},
});

}  // namespace
