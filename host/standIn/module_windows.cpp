#include <windows.h>

#include <system_error>

#include "components/support/path.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/module.h"

namespace Ov {

namespace {

constexpr std::uint32_t lastOrdinal = 0xFFFF;

void* address(FARPROC function) { return reinterpret_cast<void*>(function); }

}  // namespace

void* Module::load(const std::wstring& path) {
    const HMODULE handle = LoadLibraryW(path.c_str());
    if (!handle) {
        const int error = static_cast<int>(GetLastError());
        throw ExModule(toUtf8(path) + ": " + std::system_category().message(error));
    }
    return handle;
}

Module::~Module() { FreeLibrary(static_cast<HMODULE>(_handle)); }

void* Module::byName(const char* name) const {
    return address(GetProcAddress(static_cast<HMODULE>(_handle), name));
}

void* Module::byOrdinal(std::uint32_t ordinal) const {
    // The system takes larger numbers for the addresses of names.
    if (ordinal == 0 || ordinal > lastOrdinal) return nullptr;
    return address(GetProcAddress(static_cast<HMODULE>(_handle), MAKEINTRESOURCEA(ordinal)));
}

}  // namespace Ov
