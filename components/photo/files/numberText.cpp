#include "components/photo/files/numberText.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <utility>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"
#include "components/support/textFormat.h"

namespace OvPhotometrics {

namespace {

constexpr int ctrlZ = 0x1A;

bool isBlank(int c) { return c == ' ' || (c >= '\t' && c <= '\r'); }
bool isBetween(int c) { return isBlank(c) || c == ','; }
bool startsNumber(int c) { return (c >= '0' && c <= '9') || c == '-' || c == '.'; }

}  // namespace

bool readTextLine(Ov::RnStream& in, const wchar_t* format, std::wstring& line) {
    wchar_t buffer[81] = {};
    if (in.formattedRead(format, buffer) < 0) return false;
    line = buffer;
    Ov::RnStreamInput chars(in);
    int c = chars.getChar();
    if (c == '\r') c = chars.getChar();
    if (c != '\n') chars.ungetChar(c);
    return true;
}

bool matchesAt(Ov::RnBufferedIO& io, const wchar_t* text) {
    const long start = io.seek(0, 1);
    Ov::RnCharInput in(io);
    while (*text && in.getChar() == static_cast<int>(*text)) ++text;
    io.seek(start, 0);
    return *text == 0;
}

template <class... Types>
bool NumberText::fail(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) {
    _failed = true;
    if (!_report) _report.emplace();
    _report->postParseMessage(message, arguments...);
    return false;
}

/// Goes to the start of the next number. Without one that is reported, and `instead` is what the number gives.
bool NumberText::findNumber(Ov::Message<wchar_t> unexpected, std::int32_t& instead) {
    const int c = _chars.chars().takeWhile(isBetween);
    if (startsNumber(c)) return true;
    instead = 0;
    if (c >= 0) {
        _chars.getChar();
        return fail(unexpected, c == 0 ? L' ' : static_cast<wchar_t>(c));  // a NUL would end the message
    }
    const bool first = !_ended;
    _ended = true;
    if (_atEnd == AtEnd::unexpectedBlank) return first && fail(unexpected, L' ');
    instead = -1;
    return first && fail(messages::numberNotConverted);
}

/// Whether the number ends here. One that runs on into something else is refused: reading on in the middle of it would
/// shift all values behind it.
bool NumberText::atNumberEnd() {
    const int c = _chars.peekChar();
    return c < 0 || isBetween(c) || c == ctrlZ || c == 0;
}

/// Skips a point and the zeros behind it; a point that other digits follow stays.
void NumberText::skipZeroFraction() {
    _chars.getChar();
    if (_chars.peekChar() != '0' && !atNumberEnd()) _chars.ungetChar('.');
    while (_chars.peekChar() == '0') _chars.getChar();
}

bool NumberText::readInteger(std::int32_t& value) {
    if (!findNumber(messages::integerExpected, value)) return false;
    const bool converted = _in.formattedRead(L"%d", &value) == 1;
    if (converted && _chars.peekChar() == '.') skipZeroFraction();
    if (converted && atNumberEnd()) return true;
    value = -1;
    return fail(messages::numberNotConverted);
}

bool NumberText::readInteger(std::int32_t& value, Ov::Message<int> failure, std::int32_t least,
                             std::int32_t most) {
    readInteger(value);
    return (value >= least && value <= most) || fail(failure, value);
}

bool NumberText::readFloat(float& value) {
    std::int32_t instead;
    if (!findNumber(messages::floatExpected, instead)) {
        value = static_cast<float>(instead);
        return false;
    }
    if (_in.formattedRead(L"%f", &value) == 1 && atNumberEnd()) return true;
    value = -1;
    return fail(messages::numberNotConverted);
}

bool NumberText::readFloats(std::size_t count, std::vector<float>& values) {
    // The next values are no more than every second byte that is at hand.
    const Ov::RnCharInput& ready = _chars.chars();
    values.clear();
    values.reserve(std::min(count, static_cast<std::size_t>(ready.limit() - ready.next()) / 2 + 1));
    for (std::size_t i = 0; i < count && !_ended; ++i) readFloat(values.emplace_back());
    return !_failed;
}

void writeText(std::string_view bytes, Ov::RnStream& out) {
    std::wstring text(bytes.size(), L'\0');
    std::transform(bytes.begin(), bytes.end(), text.begin(),
                   [](char c) { return static_cast<wchar_t>(static_cast<unsigned char>(c)); });
    const int count = std::in_range<int>(text.size()) ? static_cast<int>(text.size()) : -1;
    if (count < 0 || out.device().writeChars(text.data(), count) != count)
        throw Ov::RnStreamEx::ExWriteError("components/photo/files/numberText", __LINE__, "file");
    out.column = 0;
    out.pendingSeparator = false;
}

void appendNumber(std::wstring& out, float value, FileForm form, int decimals) {
    if (form == FileForm::faithful) {
        const float size = std::fabs(value);
        const bool isPlain = size == 0 || (size >= 1e-5f && size < 1e9f);
        char text[64];
        const auto end = std::to_chars(text, text + sizeof text, value,
                                       isPlain ? std::chars_format::fixed : std::chars_format::scientific);
        out.append(text, end.ptr);
        return;
    }
    Ov::Directive directive;
    directive.precision = decimals < 0 ? 16 : decimals;
    directive.letter = decimals < 0 ? L'g' : L'f';
    Ov::appendDouble(out, directive, value);
}

std::wstring numbersText(std::initializer_list<float> values, FileForm form, int decimals) {
    std::wstring text;
    for (const float value : values) {
        if (!text.empty()) text += L' ';
        appendNumber(text, value, form, decimals);
    }
    return text;
}

void writeValueList(std::size_t count, const float* values, Ov::RnStream& out, int limit, FileForm form) {
    std::wstring item;
    int length = 0;
    for (std::size_t i = 0; i < count; ++i) {
        item.assign(1, L' ');
        appendNumber(item, values[i], form, 2);
        const int width = static_cast<int>(item.size());
        length += width;
        if (length >= limit) {
            endLine(out);
            length = width;
        }
        writeItem(out, item.data(), width);
    }
    endLine(out);
}

}  // namespace OvPhotometrics
