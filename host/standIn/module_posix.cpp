#include <dlfcn.h>

#include "components/support/path.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/module.h"
#include "ovphoto/numberedExports.h"

namespace Ov {

namespace {

/// The system's reason; it may repeat the path.
std::string loadFailure(const std::string& path) {
    const char* text = dlerror();
    const std::string reason = text ? text : "cannot be loaded";
    return reason.starts_with(path) ? reason : path + ": " + reason;
}

}  // namespace

void* Module::load(const std::wstring& path) {
    const std::string native = toUtf8(path);
    void* const handle = dlopen(native.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!handle) throw ExModule(loadFailure(native));
    return handle;
}

Module::~Module() { dlclose(_handle); }

void* Module::byName(const char* name) const { return dlsym(_handle, name); }

void* Module::byOrdinal(std::uint32_t ordinal) const {
    const auto* entry = static_cast<const RnNumberedExport*>(byName("RnNumberedExports"));
    if (!entry) return nullptr;
    while (entry->ordinal != 0 && entry->ordinal != ordinal) ++entry;
    return reinterpret_cast<void*>(entry->function);
}

}  // namespace Ov
