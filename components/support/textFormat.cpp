#include "components/support/textFormat.h"

#include <algorithm>
#include <bit>
#include <charconv>
#include <cmath>
#include <string_view>
#include <utility>

namespace Ov {

namespace {

// The longest number: 309 digits before the point, or as many zeros behind it as the precision asks for.
constexpr std::size_t maxNumberLength = maxFormatWidth + 400;

bool isFlag(wchar_t c, Directive& directive) {
    switch (c) {
        case L'-':
            return directive.left = true;
        case L'+':
            return directive.plus = true;
        case L' ':
            return directive.blank = true;
        case L'#':
            return directive.alternate = true;
        case L'0':
            return directive.zeros = true;
        default:
            return false;
    }
}

/// Reads a number, or an asterisk, into `value`; the position behind it, or null for a number that is too large.
const wchar_t* parseCount(const wchar_t* text, const wchar_t* end, int& value, bool& isArgument) {
    value = 0;
    if (text != end && *text == L'*') {
        isArgument = true;
        return text + 1;
    }
    for (; text != end && *text >= L'0' && *text <= L'9'; ++text) {
        value = 10 * value + static_cast<int>(*text - L'0');
        if (value > maxFormatWidth) return nullptr;
    }
    return text;
}

void appendAscii(std::wstring& out, std::string_view text) {
    const std::size_t start = out.size();
    out.resize(start + text.size());
    std::transform(text.begin(), text.end(), out.begin() + static_cast<std::ptrdiff_t>(start),
                   [](char c) { return static_cast<wchar_t>(c); });
}

std::size_t padding(const Directive& directive, std::size_t used) {
    const auto width = static_cast<std::size_t>(std::max(directive.width, 0));
    return width > used ? width - used : 0;
}

/// Appends sign or prefix, zeros and digits as one field. `fillWithZeros`: the field is filled behind the prefix.
void appendNumber(std::wstring& out, const Directive& directive, std::string_view prefix, std::size_t zeros,
                  std::string_view digits, bool fillWithZeros) {
    std::size_t pad = padding(directive, prefix.size() + zeros + digits.size());
    if (fillWithZeros && !directive.left) zeros += std::exchange(pad, 0);
    if (!directive.left) out.append(pad, L' ');
    appendAscii(out, prefix);
    out.append(zeros, L'0');
    appendAscii(out, digits);
    if (directive.left) out.append(pad, L' ');
}

void appendCharacter(std::wstring& out, const Directive& directive, wchar_t c) {
    const std::size_t pad = padding(directive, 1);
    if (!directive.left) out.append(pad, L' ');
    out.push_back(c);
    if (directive.left) out.append(pad, L' ');
}

std::string_view signOf(const Directive& directive, bool negative) {
    return negative ? "-" : directive.plus ? "+" : directive.blank ? " " : "";
}

void makeUpper(char* text, char* end) {
    std::transform(text, end, text,
                   [](char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; });
}

bool isSignedLetter(wchar_t letter) { return letter == L'd' || letter == L'i'; }

int baseOf(wchar_t letter) {
    switch (letter) {
        case L'x':
        case L'X':
            return 16;
        case L'o':
            return 8;
        default:
            return 10;
    }
}

/// The exponent that %e would show for `value`.
int decimalExponent(double value, int precision, char* buffer) {
    char* end =
        std::to_chars(buffer, buffer + maxNumberLength, value, std::chars_format::scientific, precision).ptr;
    const char* e = std::find(buffer, end, 'e');
    int exponent = 0;
    std::from_chars(e + (e[1] == '+' ? 2 : 1), end, exponent);
    return exponent;
}

/// Puts in the point that the alternate form always has; returns the new end.
char* ensurePoint(char* text, char* end) {
    if (std::find(text, end, '.') != end) return end;
    char* place = std::find(text, end, 'e');
    std::copy_backward(place, end, end + 1);
    *place = '.';
    return end + 1;
}

/// As std::to_chars with a few decimals, for a value that a float holds, whose product with a small power of ten
/// is an exact integer over a power of two. Null for other values.
char* convertFixedFloat(char* buffer, double value, int precision) {
    static constexpr std::uint64_t powers[] = {1, 10, 100, 1000, 10000};
    const auto bits = std::bit_cast<std::uint64_t>(value);
    // The value is `mantissa`, of 24 bits, shifted down by `shift`.
    const auto mantissa = (bits & ((1ULL << 52) - 1)) >> 29 | 1ULL << 23;
    const int shift = 1023 + 23 - static_cast<int>(bits >> 52);
    if ((bits & ((1ULL << 29) - 1)) != 0 || shift <= 0 || shift >= 63 || precision < 1 || precision > 4) {
        return nullptr;
    }
    const std::uint64_t scaled = mantissa * powers[precision];
    const std::uint64_t rest = scaled & ((1ULL << shift) - 1);
    const std::uint64_t half = 1ULL << (shift - 1);
    std::uint64_t rounded = scaled >> shift;
    if (rest > half || (rest == half && rounded % 2 == 1)) ++rounded;

    char* const point = std::to_chars(buffer, buffer + maxNumberLength, rounded / powers[precision]).ptr;
    *point = '.';
    rounded %= powers[precision];
    for (int i = precision; i > 0; --i) {
        point[i] = static_cast<char>('0' + rounded % 10);
        rounded /= 10;
    }
    return point + precision + 1;
}

/// Writes the digits of a finite value that is not negative; returns their end.
char* convertMagnitude(char* buffer, const Directive& directive, double value) {
    char* const limit = buffer + maxNumberLength;
    int precision = directive.precision < 0 ? 6 : directive.precision;
    auto format = std::chars_format::general;
    switch (directive.letter) {
        case L'f':
        case L'F':
            format = std::chars_format::fixed;
            break;
        case L'e':
        case L'E':
            format = std::chars_format::scientific;
            break;
        default:
            precision = std::max(precision, 1);
    }
    // The alternate %g keeps its zeros, so it is the %e or %f with as many digits.
    if (format == std::chars_format::general && directive.alternate) {
        const int exponent = decimalExponent(value, precision - 1, buffer);
        const bool isFixed = exponent >= -4 && exponent < precision;
        format = isFixed ? std::chars_format::fixed : std::chars_format::scientific;
        precision -= isFixed ? exponent + 1 : 1;
    }
    // The common case is quicker without the library.
    if (format == std::chars_format::fixed) {
        if (char* end = convertFixedFloat(buffer, value, precision)) return end;
    }
    char* end = std::to_chars(buffer, limit, value, format, precision).ptr;
    return directive.alternate ? ensurePoint(buffer, end) : end;
}

}  // namespace

const wchar_t* parseDirective(const wchar_t* text, const wchar_t* end, Directive& directive) {
    directive = {};
    while (text != end && isFlag(*text, directive)) ++text;
    text = parseCount(text, end, directive.width, directive.widthIsArgument);
    if (text && text != end && *text == L'.') {
        text = parseCount(text + 1, end, directive.precision, directive.precisionIsArgument);
    }
    if (text && text != end && (*text == L'h' || *text == L'l' || *text == L'L')) directive.modifier = *text++;
    if (!text || text == end) return nullptr;
    directive.letter = *text;
    return text + 1;
}

void appendInteger(std::wstring& out, const Directive& directive, std::int32_t value) {
    // 16 bits of the value, or 32, as sign and magnitude.
    const bool isShort = directive.modifier == L'h';
    if (directive.letter == L'c' || directive.letter == L'C')
        return appendCharacter(out, directive, static_cast<wchar_t>(isShort ? value & 0xFFFF : value));
    const bool isSigned = isSignedLetter(directive.letter);
    if (isShort && isSigned) value = static_cast<std::int16_t>(value);
    const bool negative = isSigned && value < 0;
    auto magnitude = static_cast<std::uint32_t>(value);
    if (negative) magnitude = 0 - magnitude;
    if (isShort && !isSigned) magnitude &= 0xFFFF;

    // The digits. A precision of 0 shows no digit for 0.
    char buffer[16];
    const int base = baseOf(directive.letter);
    char* end = std::to_chars(buffer, buffer + sizeof buffer, magnitude, base).ptr;
    if (directive.letter == L'X') makeUpper(buffer, end);
    if (magnitude == 0 && directive.precision == 0) end = buffer;
    std::string_view digits(buffer, static_cast<std::size_t>(end - buffer));

    // Zeros up to the precision; in front of them the sign, or what tells the base.
    const auto wanted = static_cast<std::size_t>(std::max(directive.precision, 0));
    std::size_t zeros = wanted > digits.size() ? wanted - digits.size() : 0;
    if (directive.alternate && base == 8 && zeros == 0 && !digits.starts_with('0')) zeros = 1;
    std::string_view prefix = isSigned ? signOf(directive, negative) : "";
    if (directive.alternate && base == 16 && magnitude != 0) prefix = directive.letter == L'X' ? "0X" : "0x";
    appendNumber(out, directive, prefix, zeros, digits, directive.zeros && directive.precision < 0);
}

void appendDouble(std::wstring& out, const Directive& directive, double value) {
    char buffer[maxNumberLength];
    const bool isFinite = std::isfinite(value);
    char* end = buffer + 3;
    if (isFinite) {
        end = convertMagnitude(buffer, directive, std::fabs(value));
    } else {
        std::copy_n(std::isnan(value) ? "nan" : "inf", 3, buffer);
    }
    if (directive.letter >= L'A' && directive.letter <= L'Z') makeUpper(buffer, end);
    const std::string_view digits(buffer, static_cast<std::size_t>(end - buffer));
    appendNumber(out, directive, signOf(directive, std::signbit(value)), 0, digits, directive.zeros && isFinite);
}

void appendText(std::wstring& out, const Directive& directive, const wchar_t* text) {
    if (!text) text = L"";
    // With a precision the text need not be terminated.
    std::size_t length = 0;
    const auto most = directive.precision < 0 ? std::wstring::npos : static_cast<std::size_t>(directive.precision);
    while (length < most && text[length] != 0) ++length;
    const std::size_t pad = padding(directive, length);
    if (!directive.left) out.append(pad, L' ');
    out.append(text, length);
    if (directive.left) out.append(pad, L' ');
}

}  // namespace Ov
