#include "components/support/path.h"

namespace Ov {

std::filesystem::path nativePath(std::wstring_view path) { return std::filesystem::path(path); }
std::wstring widePath(const std::filesystem::path& path) { return path.native(); }

}  // namespace Ov
