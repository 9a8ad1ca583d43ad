#pragma once

#include <cstdint>
#include <initializer_list>
#include <limits>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "components/photo/lid/reportMessage.h"
#include "components/support/streamText.h"
#include "ovphoto/photoFormat.h"

// Lines, free-form numbers and value lists of text formats.

namespace OvPhotometrics {

using Ov::FileForm;

/// Reads one line through `format` ("%80[^\r\n]": up to 80 characters, the most there may be), and its end: CR LF,
/// LF or a lone CR. A longer line goes on as the next. False at the end of the input.
bool readTextLine(Ov::RnStream& in, const wchar_t* format, std::wstring& line);

/// Whether the text at the current position of `io` starts with `text`; the position is kept.
bool matchesAt(Ov::RnBufferedIO& io, const wchar_t* text);

/// Reads numbers that white space and commas separate, wherever lines break. A number must start with a digit, "-"
/// or "." and end at white space, a comma, Ctrl-Z, NUL or the end of the input.
///
/// Errors:   a number that fails is reported (12946 to 12948, inside the general reading message), the end of the
///           input once; the operations then answer false, and `failed` stays true. The value is 0 for an
///           unexpected character, which is consumed, and -1 for what cannot be converted.
class NumberText {
public:
    /// How a number is reported that the input ends before.
    enum class AtEnd { notConverted, unexpectedBlank };

    explicit NumberText(Ov::RnStream& in, AtEnd atEnd) : _in(in), _chars(in), _atEnd(atEnd) {}

    /// A fraction of zeros ("73.0") counts as part of an integer.
    bool readInteger(std::int32_t& value);
    /// An integer from `least` to `most`; another value is reported through `failure`, its argument.
    bool readInteger(std::int32_t& value, Ov::Message<int> failure, std::int32_t least,
                     std::int32_t most = std::numeric_limits<std::int32_t>::max());
    bool readFloat(float& value);
    /// Reads a group to its end, even when a number fails; only the end of the input ends it. Memory is taken as
    /// values arrive. Throws std::bad_alloc.
    bool readFloats(std::size_t count, std::vector<float>& values);

    bool failed() const { return _failed; }
    /// Whether a number was wanted behind the end of the input.
    bool ended() const { return _ended; }

private:
    bool findNumber(Ov::Message<wchar_t> unexpected, std::int32_t& instead);
    bool atNumberEnd();
    void skipZeroFraction();
    template <class... Types>
    bool fail(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments);

    Ov::RnStream& _in;
    Ov::RnStreamInput _chars;
    AtEnd _atEnd;
    bool _failed = false;
    bool _ended = false;
    std::optional<Report> _report;  // from the first fault on: there may be thousands
};

/// Writes formatted text and ends the line.
template <class... Args>
void writeLine(Ov::RnStream& out, const wchar_t* format, Args... args) {
    out.formattedWrite(format, args...);
    endLine(out);
}

/// Writes a text that ends its last line, all of it at once. Raises RnStreamEx::ExWriteError where the device does
/// not take it; throws std::bad_alloc before.
void writeText(std::string_view bytes, Ov::RnStream& out);

/// Appends a number. A save gives it `decimals`, or 16 digits in all where that is below 0; a faithful file the
/// shortest text that reads back as the same float, with an exponent where it would be long otherwise.
void appendNumber(std::wstring& out, float value, FileForm form, int decimals = -1);
/// Numbers with a blank between them.
std::wstring numbersText(std::initializer_list<float> values, FileForm form, int decimals = -1);

/// Writes values, with two decimals in a save, each behind a blank, as lines of less than `limit` characters.
void writeValueList(std::size_t count, const float* values, Ov::RnStream& out, int limit, FileForm form);

}  // namespace OvPhotometrics
