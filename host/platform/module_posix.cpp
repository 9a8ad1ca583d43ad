#include <dlfcn.h>

#include "host/componentManager/componentManager.h"
#include "host/platform/file.h"
#include "host/platform/module.h"
#include "host/platform/path.h"
#include "ovphoto/numberedExports.h"

namespace Ov {

namespace {

/// The system looks for a name without a folder in its own places, and the empty name is the program itself: only
/// absolute paths of regular files go there.
std::wstring modulePath(const std::wstring& path) {
    std::error_code error;
    const std::filesystem::path native = nativePath(path);
    if (!std::filesystem::is_regular_file(native, error)) throw ExModule(openFailure(path.c_str()));
    return widePath(std::filesystem::absolute(native));
}

/// The system's reason; it may repeat the path.
std::string loadFailure(const std::string& path) {
    const char* text = dlerror();
    const std::string reason = text ? text : "cannot be loaded";
    return reason.starts_with(path) ? reason : path + ": " + reason;
}

}  // namespace

Module::Module(const std::wstring& path) : _path(modulePath(path)), _handle(nullptr) {
    const std::string native = toUtf8(_path);
    _handle = dlopen(native.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (!_handle) throw ExModule(loadFailure(native));
}

Module::~Module() { dlclose(_handle); }

void* Module::byName(const char* name) const { return dlsym(_handle, name); }

void* Module::byOrdinal(std::uint32_t ordinal) const {
    const auto* entry = static_cast<const RnNumberedExport*>(byName("RnNumberedExports"));
    if (!entry) return nullptr;
    while (entry->ordinal != 0 && entry->ordinal != ordinal) ++entry;
    return reinterpret_cast<void*>(entry->function);
}

RnComponentRegistry& Module::registry() const {
    auto* entry = reinterpret_cast<RnGetComponentDescriptionFunction*>(byName("RnGetComponentDescription"));
    RnComponentRegistry* found = entry ? entry() : nullptr;
    if (!found) throw ExModule(toUtf8(_path) + ": RnGetComponentDescription is missing");
    return *found;
}

}  // namespace Ov
