#include "components/support/path.h"

namespace Ov {

std::filesystem::path nativePath(std::wstring_view path) { return std::filesystem::path(toUtf8(path)); }
std::wstring widePath(const std::filesystem::path& path) { return fromUtf8(path.native()); }

}  // namespace Ov
