#pragma once

#include <filesystem>
#include <string>
#include <string_view>

namespace Ov {

/// @{
/// Paths and texts are UTF-8 outside and wide inside, whatever the locale. Any bytes survive the way in and out: a
/// byte that is no UTF-8 stands as 0xDC00 plus its value. So does any Unicode text the way out and in; a wide
/// character that is neither Unicode nor such a byte goes out as U+FFFD.
std::string toUtf8(std::wstring_view text);
std::wstring fromUtf8(std::string_view text);
/// @}

/// @{
/// Paths by the same rule.
std::filesystem::path nativePath(std::wstring_view path);
std::wstring widePath(const std::filesystem::path& path);
/// @}

/// @{
/// The name of a file without folder and extension, and its folder ("." when the path has none).
std::wstring pathStem(std::wstring_view path);
std::wstring pathFolder(std::wstring_view path);
/// @}

}  // namespace Ov
