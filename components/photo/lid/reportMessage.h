#pragma once

namespace OvPhotometrics {

/// Formats a message of the catalogue with its arguments (ints, doubles and wide strings, as its text says) and
/// posts it to the host's message reporter. Without a catalogue the message is its number, "Message 12960.".
///
/// Errors:   only a host without a controller raises: ExBadCast.
/// Threads:  one at a time; the last text is kept in one string of the library.
void reportMessage(unsigned id, ...);

/// The same for what is wrong with a text: the message stands inside the general reading message (alone without a
/// catalogue).
void reportParseMessage(unsigned id, ...);

}  // namespace OvPhotometrics
