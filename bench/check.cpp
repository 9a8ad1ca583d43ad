#include <sys/resource.h>

#include <cstdlib>
#include <filesystem>
#include <fstream>

#include "bench/bench.h"

// The built tool's `check` on a folder of many files, beside a loop that opens, reads and walks the same files.
// Both by the time of the processor, in user and system: other programs that run do not count.

namespace {

/// 2000 copies of an IES file of 17 KiB, each of its own candelas, in a temporary folder that goes with the
/// program.
class Folder {
public:
    Folder() : _path((std::filesystem::temp_directory_path() / "ovphoto_bench_XXXXXX").string()) {
        if (!mkdtemp(_path.data())) throw std::runtime_error("no temporary folder");
        const std::string text = bench::iesText(73, 37, true);
        for (int k = 0; k < 2000; ++k) {
            std::string name = std::to_string(k);
            name.insert(0, 4 - name.size(), '0');
            const auto file = std::filesystem::path(_path) / (name + ".ies");
            std::string own = text;
            own.replace(own.find("generated"), 9, "file " + name);
            std::ofstream(file, std::ios::binary) << own;
            _files.push_back(file.string());
        }
    }
    ~Folder() { std::filesystem::remove_all(_path); }

    const std::string& path() const { return _path; }
    const std::vector<std::string>& files() const { return _files; }

private:
    std::string _path;
    std::vector<std::string> _files;
};

const Folder& folder() {
    static const Folder made;
    return made;
}

double childSeconds() {
    rusage usage{};
    getrusage(RUSAGE_CHILDREN, &usage);
    const auto seconds = [](const timeval& time) {
        return static_cast<double>(time.tv_sec) + 1e-6 * static_cast<double>(time.tv_usec);
    };
    return seconds(usage.ru_utime) + seconds(usage.ru_stime);
}

void check(benchmark::State& state) {
    const std::string command = OVPHOTO_TOOL " check " + folder().path() + " > /dev/null";
    for (auto _ : state) {
        const double before = childSeconds();
        if (std::system(command.c_str()) != 0) state.SkipWithError("the tool failed");
        state.SetIterationTime(childSeconds() - before);
    }
}

void checkFloor(benchmark::State& state) {
    std::string text;
    for (auto _ : state)
        for (const std::string& name : folder().files()) {
            std::ifstream file(name, std::ios::binary);
            text.resize(std::filesystem::file_size(name));
            file.read(text.data(), static_cast<std::streamsize>(text.size()));
            benchmark::DoNotOptimize(bench::walkNumbers(text));
        }
}

BENCHMARK(check)->UseManualTime()->Unit(benchmark::kMillisecond);
BENCHMARK(checkFloor)->Unit(benchmark::kMillisecond);

const bool listed = bench::addRatios({{.what = "check of 2000 files, time over reading and from_chars",
                                       .ours = "check/manual_time",
                                       .floor = "checkFloor",
                                       .atMost = 2.5}});

}  // namespace
