#include <malloc.h>

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <ctime>
#include <filesystem>
#include <fstream>
#include <iterator>
#include <new>
#include <string>
#include <vector>

#include "fuzz/fuzz.h"

// Usage: <target> [--milliseconds N] PATH...
// Goes through files, and the files of folders, those of OVPHOTO_SAMPLES too, without an engine. A file whose name
// starts with "flood" goes on with its last byte for 1 MiB. Reading an input may take 32 MiB and 40 times its size
// of memory, and, with the option, N milliseconds of processor time for each 64 KiB or part, in one of three
// attempts.

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

namespace {

namespace fs = std::filesystem;

std::size_t held = 0, mostHeld = 0;
double milliseconds = 0;  // 0: any
bool slow = false;        // whether the current attempt has taken longer

void* allocate(std::size_t size) {
    void* const block = std::malloc(std::max<std::size_t>(size, 1));
    if (!block) throw std::bad_alloc();
    mostHeld = std::max(mostHeld, held += malloc_usable_size(block));
    return block;
}

void release(void* block) {
    held -= malloc_usable_size(block);
    std::free(block);
}

double processorTime() { return 1e3 * static_cast<double>(std::clock()) / CLOCKS_PER_SEC; }

void replay(const fs::path& path) {
    std::ifstream file(path, std::ios::binary);
    std::string bytes{std::istreambuf_iterator<char>(file), {}};
    std::fprintf(stderr, "%s\n", path.c_str());
    OvPhotometrics::fuzz::demand(!file.bad() && file.is_open(), "the input can be read");
    if (path.filename().string().starts_with("flood")) bytes.resize(1 << 20, bytes.back());
    for (int attempt = 0; attempt == 0 || (slow && attempt < 3); ++attempt) {
        slow = false;
        LLVMFuzzerTestOneInput(reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size());
    }
    OvPhotometrics::fuzz::demand(!slow, "time");
}

}  // namespace

#include "tests/support/replacedHeap.h"

bool OvPhotometrics::fuzz::isDue(std::string_view, std::size_t, std::size_t) { return true; }

void OvPhotometrics::fuzz::measured(std::size_t size, const std::function<void()>& work) {
    const std::size_t before = mostHeld = held;
    const double start = processorTime();
    work();
    const double took = processorTime() - start;
    const std::size_t taken = mostHeld - before;
    std::fprintf(stderr, "  %zu bytes: %zu KiB, %.2f ms\n", size, taken / 1024, took);
    demand(taken <= (32 << 20) + 40 * size, "memory");
    slow |= milliseconds > 0 && took > milliseconds * static_cast<double>(size / 65537 + 1);
}

int main(int count, char** arguments) {
    std::vector<fs::path> paths(arguments + 1, arguments + count);
    if (paths.size() > 1 && paths[0] == "--milliseconds") {
        milliseconds = std::stod(paths[1]);
        paths.erase(paths.begin(), paths.begin() + 2);
    }
    if (const char* samples = std::getenv("OVPHOTO_SAMPLES")) paths.push_back(samples);
    for (const fs::path& path : paths) {
        if (!fs::is_directory(path)) {
            replay(path);
            continue;
        }
        for (const auto& entry : fs::recursive_directory_iterator(path))
            if (entry.is_regular_file()) replay(entry.path());
    }
}
