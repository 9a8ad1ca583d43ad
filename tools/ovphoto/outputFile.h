#pragma once

#include <string>
#include <string_view>

namespace OvTool {

/// Writes to standard output as "-". Otherwise writes a file whole or not at all: to a new file beside it, which is then renamed. A link is followed and the
/// permissions of a file that exists are kept. Empty, or why it failed; then nothing has changed.
std::string writeFile(const std::string& file, std::string_view bytes);

}  // namespace OvTool
