#include <charconv>

#include "bench/bench.h"
#include "components/support/devices.h"
#include "host/componentManager/persistant.h"
#include "host/componentManager/stream.h"

// Saving of webs, each in its own format, beside a bare loop of std::to_chars with two decimals over the values that
// IES and CIBSE files hold. NIMB and TBT webs are sampled anew as they are saved, which their rate includes.

namespace {

namespace ids = OvPhotometrics::classIds;

constexpr int vertical = 181;
constexpr int horizontal = 360;

const Ov::RnRef<Ov::RnPhotoWebData>& web(std::int64_t which) {
    static const std::vector<Ov::RnRef<Ov::RnPhotoWebData>> webs = [] {
        std::vector<Ov::RnRef<Ov::RnPhotoWebData>> all{bench::webOf(vertical, horizontal)};
        for (const Ov::RnUid& id : {ids::cibseWeb, ids::nimbWeb, ids::tbtWeb})
            all.push_back(bench::import(id, bench::fileText(id, *all.front())));
        return all;
    }();
    return webs[static_cast<std::size_t>(which)];
}

void save(benchmark::State& state) {
    const auto& saved = web(state.range(0));
    std::size_t bytes = 0;
    for (auto _ : state) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        Ov::rnCast<Ov::RnPersistant>(saved.get())->save(stream);
        bytes = io->bytes().size();
    }
    bench::countBytes(state, bytes);
}

void saveFloor(benchmark::State& state) {
    const auto& saved = web(0);
    std::vector<float> values(static_cast<std::size_t>(vertical) * horizontal);
    saved->getCandelaBlock({0, horizontal - 1}, {0, vertical - 1}, values.data());
    std::string text(values.size() * 16, ' ');
    std::size_t bytes = 0;
    for (auto _ : state) {
        char* p = text.data();
        for (const float value : values) {
            p = std::to_chars(p, text.data() + text.size(), value, std::chars_format::fixed, 2).ptr;
            *p++ = ' ';
        }
        benchmark::ClobberMemory();
        bytes = static_cast<std::size_t>(p - text.data());
    }
    bench::countBytes(state, bytes);
}

BENCHMARK(save)->DenseRange(0, 3);
BENCHMARK(saveFloor);

const bool listed = bench::addRatios({
    {.what = "save IES 181 x 360, rate over to_chars", .ours = "save/0", .floor = "saveFloor"},
    {.what = "save CIBSE 181 x 360, rate over to_chars", .ours = "save/1", .floor = "saveFloor"},
    {.what = "save NIMB 181 x 360, rate over to_chars", .ours = "save/2", .floor = "saveFloor"},
    {.what = "save TBT 181 x 360, rate over to_chars", .ours = "save/3", .floor = "saveFloor"},
});

}  // namespace
