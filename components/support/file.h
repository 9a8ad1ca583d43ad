#pragma once

#include <string>

#include "components/support/devices.h"

namespace Ov {

/// An input device over a file, which is closed with it. Null unless `path` is a regular file, links followed,
/// that can be opened: folders, pipes and devices do not count, and are not opened.
RnRef<RnBufferedIO> openInputFile(const wchar_t* path);

/// Why `openInputFile` refuses a path, for the user and in UTF-8: the path and the reason.
std::string openFailure(const wchar_t* path);

}  // namespace Ov
