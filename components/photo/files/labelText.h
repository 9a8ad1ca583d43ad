#pragma once

#include <optional>
#include <string>
#include <string_view>

// Texts of label lines and the bytes that stand for them in files. Readers keep bytes, each as a character from 0 to
// 255; people and other files are given texts.

namespace OvPhotometrics {

enum class LabelEncoding { utf8, windows1252 };

/// Nothing for a label of ASCII; UTF-8 where all of the bytes are that; else Windows-1252. A character that the end of
/// a label of `limit` bytes has cut counts for neither.
std::optional<LabelEncoding> encodingOf(std::wstring_view bytes, std::size_t limit = std::wstring::npos);

/// What the bytes say. The bytes 81, 8D, 8F, 90 and 9D, which Windows-1252 leaves open, are the control characters of
/// these numbers; a character that was cut is left out.
std::wstring textOfLabel(std::wstring_view bytes, std::size_t limit = std::wstring::npos);

/// Takes from the front of `text` the characters that fit `limit` bytes, and gives their bytes: in UTF-8, or in
/// Windows-1252 where that is wanted, has every character and reads back as the same text. Control characters below
/// 128 are blanks; a byte that stands in a name for itself (see toUtf8) is one of Windows-1252.
std::wstring takeLabel(std::wstring_view& text, std::size_t limit, LabelEncoding wanted);

/// `text` with blanks for control characters below 128, at most `limit` characters long.
std::wstring labelText(std::wstring_view text, std::size_t limit);

}  // namespace OvPhotometrics
