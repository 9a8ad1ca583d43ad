#pragma once

#include <string>

namespace OvPhotometrics {

/// Formats a message of the catalogue with its arguments (ints, doubles and wide strings, as its text says) and
/// posts it to the host's message reporter. Without a catalogue the message is its number, "Message 12960.".
///
/// Errors:   only a host without a controller raises: ExBadCast.
/// Threads:  one at a time; the last text is kept in one string of the library.
void reportMessage(unsigned id, ...);

/// The formatted text of a message, as `reportMessage` would post it.
std::wstring messageText(unsigned id, ...);

/// Posts the message `wrapper` with its arguments, the text `detail` among them. Without a catalogue `detail`
/// alone is posted, which tells more than the wrapper's number.
void reportWrapped(const std::wstring& detail, unsigned wrapper, ...);

/// What is wrong with a text: the message stands inside the general reading message.
void reportParseMessage(unsigned id, ...);

}  // namespace OvPhotometrics
