#pragma once

#include <string>
#include <string_view>

// All that people read goes out through here, a line at a time. Names, labels and messages hold what files and users
// put into them; a line shows that without letting it act on the terminal or look like a line of the tool's own.

namespace OvTool {

/// Prints a line to standard output; `text` is cleaned.
void say(std::string_view text);
/// Prints a line to standard error; `text` is cleaned.
void complain(std::string_view text);

/// Prints what became of `file`, which was written: to standard output, unless that took the file itself.
void sayOf(std::string_view file, std::string_view text);

/// The text as it is shown, on one line: a tab as a blank, other control characters, line and paragraph separators,
/// marks that turn the direction of writing, and bytes that are no UTF-8 as "\n", "\r", "\x1b" or "\u202e".
std::string printable(std::string_view text);

}  // namespace OvTool
