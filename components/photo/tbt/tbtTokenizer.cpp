#include "components/photo/tbt/tbtTokenizer.h"

#include <algorithm>
#include <charconv>
#include <limits>

#include "components/photo/tbt/tbt.h"
#include "components/support/textClass.h"
#include "components/support/textNumber.h"

namespace OvPhotometrics {

namespace {

constexpr std::size_t longestToken = 80;

constexpr std::int32_t largest = std::numeric_limits<std::int32_t>::max();

}  // namespace

std::wstring TbtTokenizer::readTitle() {
    skipBlank();
    std::wstring title;
    for (int c = take(); c >= 0 && c != '\r' && c != '\n'; c = take())
        if (title.size() < tbtTitleLength) title.push_back(static_cast<wchar_t>(c));
    return title;
}

TbtToken TbtTokenizer::next() {
    const int c = skipBlank();
    _text.clear();
    _tooLong = false;
    _kind = c < 0 ? TbtToken::endOfFile : Ov::isDigit(c) || c == '.' ? takeNumber() : takeMark();
    return _kind;
}

std::wstring TbtTokenizer::text() const {
    std::wstring wide(_text.size(), L'\0');
    // A NUL would end the message that shows it.
    std::transform(_text.begin(), _text.end(), wide.begin(),
                   [](char c) { return c ? static_cast<wchar_t>(static_cast<unsigned char>(c)) : L' '; });
    return wide;
}

bool TbtTokenizer::number(float& value) const {
    if (_kind != TbtToken::number) return false;
    // The zero makes a number of a lone point, too.
    if (!(_text.front() == '.' ? Ov::convertReal("0" + _text, value) : Ov::convertReal(_text, value)))
        value = std::numeric_limits<float>::infinity();
    return true;
}

bool TbtTokenizer::integer(std::int32_t& value) const {
    value = 0;
    const auto error = std::from_chars(_text.data(), _text.data() + _text.size(), value).ec;
    if (error != std::errc::result_out_of_range) return true;
    value = largest;
    return false;
}

std::int32_t TbtTokenizer::lineFeeds() const {
    return static_cast<std::int32_t>(std::min<std::int64_t>(_lineFeeds, largest));
}

int TbtTokenizer::take() {
    const int c = _in.getChar();
    if (c == '\n') ++_lineFeeds;
    return c;
}

void TbtTokenizer::takeToken() { add(take()); }

void TbtTokenizer::add(int c) {
    _tooLong = _text.size() == longestToken;
    if (!_tooLong) _text.push_back(static_cast<char>(c));
}

bool TbtTokenizer::takeIf(char c) {
    if (_in.peekChar() != c) return false;
    takeToken();
    return true;
}

/// Takes a number without an exponent at once where the device holds it and what follows ready. False, and nothing
/// is consumed, where it does not.
bool TbtTokenizer::takeReadyNumber() {
    Ov::RnCharInput& in = _in.chars();
    const char* const limit = in.limit();
    const char* end = in.next();
    while (end != limit && Ov::isDigit(*end)) ++end;
    if (end != limit && *end == '.') ++end;
    while (end != limit && Ov::isDigit(*end)) ++end;
    const auto length = static_cast<std::size_t>(end - in.next());
    if (end == limit || *end == 'e' || *end == 'E' || length > longestToken) return false;
    _text.assign(in.next(), length);
    in.advanceTo(end);
    return true;
}

TbtToken TbtTokenizer::takeNumber() {
    if (takeReadyNumber()) return TbtToken::number;
    enum { digits, fraction, sign, exponent } part = digits;
    _in.chars().takeWhile([&](int c) {
        if (c == '.' && part == digits) {
            part = fraction;
        } else if ((c == 'e' || c == 'E') && part <= fraction) {
            part = sign;
        } else if (part == sign && (c == '+' || c == '-' || Ov::isDigit(c))) {
            part = exponent;
        } else if (!Ov::isDigit(c)) {
            return false;
        }
        add(c);
        return true;
    });
    return _tooLong ? TbtToken::other : TbtToken::number;
}

TbtToken TbtTokenizer::takeMark() {
    takeToken();
    const char c = _text.front();
    if ((c == 'z' || c == 'Z') && takeIf('0')) return TbtToken::zeroFill;
    if (c == '-' && takeIf('1')) return TbtToken::end;
    return TbtToken::other;
}

/// Skips white space and comments. Returns the character ahead, which is not consumed; below 0 at the end.
int TbtTokenizer::skipBlank() {
    const auto takeWhiteSpace = [&](int c) {
        if (c == '\n') ++_lineFeeds;
        return Ov::isWhiteSpace(c);
    };
    for (;;) {
        const int c = _in.chars().takeWhile(takeWhiteSpace);
        if (c != '/' || !skipComment()) return c;
    }
}

/// Skips the comment that starts with the slash ahead; false, and nothing is consumed, when none does.
bool TbtTokenizer::skipComment() {
    take();
    if (_in.peekChar() != '*') {
        _in.ungetChar('/');
        return false;
    }
    take();
    int previous = 0;
    for (int c = take(); c >= 0 && !(previous == '*' && c == '/'); c = take()) previous = c;
    return true;
}

}  // namespace OvPhotometrics
