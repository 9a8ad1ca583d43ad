#pragma once

#include <string>

#include "tools/ovphoto/format.h"

namespace OvTool {

/// What an input that no reader takes may be, by the look of its first bytes: nothing at all, something compressed,
/// UTF-16, EULUMDAT, or text whose lines end in carriage returns alone. Else empty. The position goes back to the start.
std::string closeFormat(Ov::RnBufferedIO& io, const Formats& formats);

}  // namespace OvTool
