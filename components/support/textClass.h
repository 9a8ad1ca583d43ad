#pragma once

namespace Ov {

// Kinds of characters, whatever the locale. A character of a device is 0 to 255, its end is below 0.

/// Blank, tab, line feed, vertical tab, form feed, carriage return.
constexpr bool isWhiteSpace(int c) { return c == ' ' || (c >= '\t' && c <= '\r'); }
constexpr bool isDigit(int c) { return c >= '0' && c <= '9'; }

}  // namespace Ov
