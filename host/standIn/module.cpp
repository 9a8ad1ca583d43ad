#include "host/componentManager/module.h"

#include "components/support/file.h"
#include "components/support/path.h"
#include "host/componentManager/componentManager.h"
#include "ovphoto/module.h"

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

}  // namespace

Module::Module(const std::wstring& path) : _path(modulePath(path)), _handle(load(_path)) {}

RnComponentRegistry& Module::registry() const {
    auto* entry = reinterpret_cast<RnGetComponentDescriptionFunction*>(byName("RnGetComponentDescription"));
    RnComponentRegistry* found = entry ? entry() : nullptr;
    if (!found) throw ExModule(toUtf8(_path) + ": RnGetComponentDescription is missing");
    return *found;
}

}  // namespace Ov
