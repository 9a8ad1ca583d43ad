#pragma once

#include "host/componentManager/devices.h"

namespace Ov {

/// A text or binary input device over a file, which is closed with it. Null unless `path` is a regular file that
/// can be opened: folders, pipes and devices are none.
OVHOST_API RnRef<RnBufferedIO> openInputFile(const wchar_t* path);

}  // namespace Ov
