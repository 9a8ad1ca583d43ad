#pragma once

#include <string>
#include <string_view>

#include "host/componentManager/bufferedIO.h"
#include "host/componentManager/ref.h"

// The name "-", which stands for standard input where a file is read, and for standard output where one is written.

namespace OvTool {

inline bool isStandardStream(std::string_view file) { return file == "-"; }

/// Standard input, which can be read once: null, and why in `error`, from the second time on.
Ov::RnRef<Ov::RnBufferedIO> openStandardInput(std::string& error);

}  // namespace OvTool
