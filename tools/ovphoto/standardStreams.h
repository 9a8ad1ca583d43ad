#pragma once

#include <cstdint>
#include <string>
#include <string_view>

#include "host/componentManager/bufferedIO.h"
#include "host/componentManager/ref.h"

// The name "-", which stands for standard input where a file is read, and for standard output where one is written.

namespace OvTool {

inline bool isStandardStream(std::string_view file) { return file == "-"; }

/// What an input is that has more than `mostBytes`.
std::string tooLarge(std::uint64_t mostBytes);

/// All of standard input, which can be read once: null, and why in `error`, from the second time on and where it has
/// more than `mostBytes`.
Ov::RnRef<Ov::RnBufferedIO> openStandardInput(std::uint64_t mostBytes, std::string& error);

}  // namespace OvTool
