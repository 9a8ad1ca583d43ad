#include <algorithm>
#include <random>

#include "bench/bench.h"
#include "components/photo/ies/photoWebIES.h"

// Installing a record with integration of its flux, beside a copy of the block and a division of each value.

namespace {

using namespace OvPhotometrics;

constexpr int vertical = 361;
constexpr int horizontal = 721;

const PhotoWebRecord& record() {
    static const PhotoWebRecord filled = [] {
        PhotoWebRecord rec;
        photoWebRecordInit(rec, vertical, horizontal, PhotoWebSymmetry::Full, false, true, L"bench");
        std::mt19937 random(1);
        std::uniform_real_distribution<float> candela(0, 2500);
        for (int i = 0; i < vertical; ++i) photoWebRecordSetTheta(rec, i, toRadians(180.0 * i / (vertical - 1)));
        for (int j = 0; j < horizontal; ++j) {
            photoWebRecordSetPsi(rec, j, toRadians(360.0 * j / (horizontal - 1)));
            for (int i = 0; i < vertical; ++i) photoWebRecordSetCandela(rec, i, j, candela(random));
        }
        return rec;
    }();
    return filled;
}

void install(benchmark::State& state) {
    const auto web = Ov::rnCreate<PhotoWebIES>();
    for (auto _ : state) benchmark::DoNotOptimize(photoWebInstall(*web, record()));
}

void installFloor(benchmark::State& state) {
    const PhotoWebRecord& rec = record();
    constexpr std::size_t count = std::size_t{vertical} * horizontal;
    for (auto _ : state) {
        const auto block = std::make_unique_for_overwrite<float[]>(count);
        std::copy_n(rec.candelas.get(), count, block.get());
        benchmark::ClobberMemory();
        for (std::size_t k = 0; k < count; ++k) block[k] /= rec.maxCandela;
        benchmark::DoNotOptimize(block.get());
        benchmark::ClobberMemory();
    }
}

BENCHMARK(install);
BENCHMARK(installFloor);

const bool listed = bench::addRatios({{.what = "install and flux 361 x 721, time over copy and division",
                                       .ours = "install",
                                       .floor = "installFloor",
                                       .atMost = 5}});

}  // namespace
