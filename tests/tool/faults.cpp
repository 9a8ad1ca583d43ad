#include <dlfcn.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <new>

// Loaded into the tool before all else: lets things fail that it asks of the system.
//
//     OVPHOTO_MEMORY=N    of all allocations, those behind the first N fail
//     OVPHOTO_SIGNAL=N    this signal comes when a file is to be kept by the disk
//     OVPHOTO_RENAME=N    the Nth renaming fails
//     OVPHOTO_TRACE=FILE  lists there what is kept by the disk, and what gets another name

namespace {

long numberOf(const char* variable) {
    const char* const text = std::getenv(variable);
    return text ? std::atol(text) : -1;
}

void* allocate(std::size_t size) {
    static long left = numberOf("OVPHOTO_MEMORY");
    if (left == 0) throw std::bad_alloc();
    if (left > 0) --left;
    void* const block = std::malloc(size > 0 ? size : 1);
    if (!block) throw std::bad_alloc();
    return block;
}

void release(void* block) { std::free(block); }

void* allocateOrNull(std::size_t size) noexcept {
    try {
        return allocate(size);
    } catch (...) {
        return nullptr;
    }
}

void trace(const char* event) {
    const char* const file = std::getenv("OVPHOTO_TRACE");
    std::FILE* const list = file ? std::fopen(file, "a") : nullptr;
    if (!list) return;
    std::fprintf(list, "%s ", event);
    std::fclose(list);
}

template <class Function>
Function* next(const char* name) {
    return reinterpret_cast<Function*>(dlsym(RTLD_NEXT, name));
}

}  // namespace

#include "tests/support/replacedHeap.h"

void* operator new(std::size_t size, const std::nothrow_t&) noexcept { return allocateOrNull(size); }
void* operator new[](std::size_t size, const std::nothrow_t&) noexcept { return allocateOrNull(size); }

extern "C" int fsync(int descriptor) {
    struct stat found {};
    fstat(descriptor, &found);
    trace(S_ISDIR(found.st_mode) ? "folder" : "file");
    if (const long signal = numberOf("OVPHOTO_SIGNAL"); signal > 0) std::raise(static_cast<int>(signal));
    return next<int(int)>("fsync")(descriptor);
}

extern "C" int rename(const char* from, const char* to) noexcept {
    static long left = numberOf("OVPHOTO_RENAME");
    trace("rename");
    if (left > 0 && --left == 0) {
        errno = EIO;
        return -1;
    }
    return next<int(const char*, const char*)>("rename")(from, to);
}
