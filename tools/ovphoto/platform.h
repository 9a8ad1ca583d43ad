#pragma once

#include <filesystem>

// What the tool asks of the operating system; one source file for each.

namespace OvTool {

/// Makes sure that the three standard streams can be told from files opened later, even if the caller closed
/// them, and that writing to a closed pipe is an error like any other instead of the end of the process.
void prepareStandardStreams();
bool standardErrorIsTerminal();
std::filesystem::path executableFolder();
/// File name of the module, "libOVphoto.so".
const char* moduleFileName();

}  // namespace OvTool
