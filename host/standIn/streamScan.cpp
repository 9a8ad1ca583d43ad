#include <array>
#include <bit>
#include <charconv>
#include <cmath>
#include <limits>
#include <string_view>
#include <utility>

#include "components/support/textClass.h"
#include "components/support/textNumber.h"
#include "host/standIn/arguments.h"
#include "host/standIn/streamState.h"

// Formatted reading. A number that lies wholly in the device's window is converted in place; everything else goes
// character by character.

namespace Ov {

namespace {

// Numbers.

template <class T>
bool convertInteger(std::string_view token, int base, T& value) {
    return std::from_chars(token.data(), token.data() + token.size(), value, base).ec == std::errc{};
}

/// A plain decimal, digit by digit. Up to 15 of them and the power of ten below them are exact doubles, so their
/// quotient is the right double. Rounding that to float is right, too, unless it lies midway between two floats.
class ShortDecimal {
public:
    void add(int digit) {
        _digits = 10 * _digits + static_cast<std::uint64_t>(digit - '0');
        ++_count;
    }
    /// From here on digits are decimals.
    void point() { _whole = _count; }

    /// False where there are too few or too many digits, or the float is not certain.
    bool convert(bool isNegative, float& value) const {
        static constexpr double powers[] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                            1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
        constexpr std::uint64_t belowFloat = (1U << 29) - 1;
        constexpr std::uint64_t midway = 1U << 28;
        if (_count == 0 || _count > 15) return false;
        const double quotient = static_cast<double>(_digits) / powers[_whole < 0 ? 0 : _count - _whole];
        if ((std::bit_cast<std::uint64_t>(quotient) & belowFloat) == midway) return false;
        value = static_cast<float>(isNegative ? -quotient : quotient);
        return true;
    }
    bool convert(bool isNegative, std::int32_t& value) const {
        if (_count == 0 || _count > 9) return false;
        value = static_cast<std::int32_t>(isNegative ? -_digits : _digits);
        return true;
    }

private:
    std::uint64_t _digits = 0;
    int _count = 0;
    int _whole = -1;  // digits before the point; none yet
};

/// Converts a plain decimal of up to 15 digits; the position behind it, or null for anything else.
const char* convertShort(const char* text, const char* limit, float& value) {
    const bool isNegative = *text == '-';
    if (isNegative) ++text;
    ShortDecimal decimal;
    for (; text != limit && isDigit(*text); ++text) decimal.add(*text);
    if (text != limit && *text == '.') {
        decimal.point();
        for (++text; text != limit && isDigit(*text); ++text) decimal.add(*text);
    }
    if (text == limit || *text == 'e' || *text == 'E') return nullptr;
    return decimal.convert(isNegative, value) ? text : nullptr;
}

/// Converts the number that starts at `text`; the position behind it, or null when it is not plain or not known to
/// end before `limit`.
const char* convertPlain(const char* text, const char* limit, float& value) {
    if (const char* stop = convertShort(text, limit, value)) return stop;
    const auto [stop, error] = std::from_chars(text, limit, value);
    // An exponent without digits belongs to the number all the same.
    const bool isPlain = error == std::errc{} && stop != limit && *stop != 'e' && *stop != 'E';
    return isPlain && std::isfinite(value) ? stop : nullptr;
}

const char* convertPlain(const char* text, const char* limit, std::int32_t& value) {
    const auto [stop, error] = std::from_chars(text, limit, value);
    return error == std::errc{} && stop != limit ? stop : nullptr;
}

/// Reads a number where the window holds white space, the number and what follows it. False, with nothing consumed
/// or changed, in every other case.
template <class T>
bool readInWindow(RnCharInput& input, T& value) {
    const char* start = input.next();
    const char* const limit = input.limit();
    while (start != limit && isWhiteSpace(*start)) ++start;
    const char* digits = start != limit && *start == '-' ? start + 1 : start;
    if (digits == limit || !(isDigit(*digits) || *digits == '.')) return false;
    T result;
    const char* stop = convertPlain(start, limit, result);
    if (!stop) return false;
    value = result;
    input.advanceTo(stop);
    return true;
}

// Input and format.

/// The start of a number, up to where it may end, that has been taken from the input.
struct NumberStart {
    static constexpr int longest = 40;

    std::array<char, longest> text;
    std::size_t length = 0;
    int ahead;  // the character behind it, taken, too; -1 at the end of the input
    ShortDecimal decimal;

    /// Takes white space, "-", digits and, for `hasFraction`, a point and more digits.
    NumberStart(RnCharInput& input, bool hasFraction) {
        ShortDecimal number;  // local, as all that changes with every character
        char* end = text.data();
        const char* const limit = end + longest;
        int c = input.getChar();
        const auto take = [&] {
            *end++ = static_cast<char>(c);
            c = input.getChar();
        };
        const auto takeDigits = [&] {
            for (; isDigit(c) && end != limit; take()) number.add(c);
        };
        while (isWhiteSpace(c)) c = input.getChar();
        if (c == '-') take();
        takeDigits();
        if (hasFraction && c == '.' && end != limit) {
            number.point();
            take();
            takeDigits();
        }
        length = static_cast<std::size_t>(end - text.data());
        ahead = c;
        decimal = number;
    }
    /// Converts all of it; false where it goes on, or does not convert simply.
    template <class T>
    bool convert(T& value) const {
        return length > 0 && ahead != 'e' && ahead != 'E' && decimal.convert(text[0] == '-', value);
    }
};

/// The input of one call, with a look-ahead of one character. Inside a field no more than its width is seen.
class Input {
public:
    explicit Input(RnCharInput& chars) : _chars(chars) {}
    /// Goes on with what has been taken, all of which the field takes again.
    Input(RnCharInput& chars, const NumberStart& start)
        : _chars(chars), _start(start.text.data(), start.length), _behindStart(start.ahead) {}

    /// The next character, or -1 at the end of the input or of the field.
    int peek() {
        if (_left == 0) return -1;
        if (_ahead == unread) _ahead = fetch();
        return _ahead;
    }
    void take() {
        _ahead = unread;
        --_left;
        ++_consumed;
    }
    void takeTo(std::string& token) {
        token.push_back(static_cast<char>(peek()));
        take();
    }
    bool takeIf(int c) {
        if (peek() != c) return false;
        take();
        return true;
    }
    void skipWhiteSpace() {
        while (isWhiteSpace(peek())) take();
    }
    void setField(int width) { _left = width; }
    void endField() { _left = std::numeric_limits<int>::max(); }
    void pushBack() {
        if (_ahead != unread) _chars.ungetChar(_ahead);
        _ahead = unread;
    }
    int consumed() const { return _consumed; }

private:
    static constexpr int unread = -2;

    int fetch() {
        if (_start.empty()) return _behindStart == unread ? _chars.getChar() : std::exchange(_behindStart, unread);
        const int c = _start.front();
        _start.remove_prefix(1);
        return c;
    }

    RnCharInput& _chars;
    std::string_view _start;
    int _behindStart = unread;
    int _ahead = unread;
    int _left = std::numeric_limits<int>::max();
    int _consumed = 0;
};

/// One conversion of a format.
struct Directive {
    bool suppress = false;
    int width = 0;  // 0: none given
    wchar_t modifier = 0;
    wchar_t letter = 0;
    std::wstring_view set;  // of %[
    bool setExcludes = false;

    int fieldWidth() const { return width > 0 ? width : std::numeric_limits<int>::max(); }
    bool skipsWhiteSpace() const { return letter != L'[' && letter != L'c' && letter != L'n'; }
    bool setHolds(int c) const;
};

bool Directive::setHolds(int c) const {
    for (std::size_t i = 0; i < set.size(); ++i) {
        const bool isRange = i + 2 < set.size() && set[i + 1] == L'-';
        const auto first = static_cast<int>(set[i]);
        const auto last = static_cast<int>(isRange ? set[i + 2] : set[i]);
        if (c >= first && c <= last) return !setExcludes;
        if (isRange) i += 2;
    }
    return setExcludes;
}

/// Reads the set of %[, which starts behind the bracket; the position behind its end. A bracket that comes first
/// belongs to the set.
const wchar_t* parseSet(const wchar_t* format, Directive& directive) {
    directive.setExcludes = *format == L'^';
    if (directive.setExcludes) ++format;
    const wchar_t* end = *format == L']' ? format + 1 : format;
    while (*end != 0 && *end != L']') ++end;
    directive.set = std::wstring_view(format, static_cast<std::size_t>(end - format));
    return *end == 0 ? end : end + 1;
}

/// Reads a directive, which starts behind the percent sign; the position behind it.
const wchar_t* parseDirective(const wchar_t* format, Directive& directive) {
    constexpr int widest = 100'000'000;
    if (*format == L'*') {
        directive.suppress = true;
        ++format;
    }
    for (; *format >= L'0' && *format <= L'9'; ++format) {
        if (directive.width < widest) directive.width = 10 * directive.width + static_cast<int>(*format - L'0');
    }
    if (*format == L'h' || *format == L'l') directive.modifier = *format++;
    directive.letter = *format;
    if (*format != 0) ++format;
    return directive.letter == L'[' ? parseSet(format, directive) : format;
}

/// Collects the longest text that starts as a number, "+" left out; false when it is no number yet.
bool collectReal(Input& input, std::string& token) {
    const auto takeDigits = [&] {
        const std::size_t before = token.size();
        while (isDigit(input.peek())) input.takeTo(token);
        return token.size() != before;
    };
    if (input.peek() == '-') {
        input.takeTo(token);
    } else {
        input.takeIf('+');
    }
    bool hasDigits = takeDigits();
    if (input.peek() == '.') {
        input.takeTo(token);
        hasDigits |= takeDigits();
    }
    if (!hasDigits) return false;
    if (input.peek() != 'e' && input.peek() != 'E') return true;
    input.takeTo(token);
    if (input.peek() == '+' || input.peek() == '-') input.takeTo(token);
    return takeDigits();
}

bool isDigitOf(int c, int base) {
    if (base == 16 && ((c >= 'a' && c <= 'f') || (c >= 'A' && c <= 'F'))) return true;
    return isDigit(c) && c - '0' < base;
}

/// Collects an integer without its prefix. Base 0 is told by the prefix and then set.
void collectInteger(Input& input, std::string& token, int& base) {
    if (input.peek() == '-') {
        input.takeTo(token);
    } else {
        input.takeIf('+');
    }
    if ((base == 0 || base == 16) && input.takeIf('0')) {
        if (input.takeIf('x') || input.takeIf('X')) {
            base = 16;
        } else {
            token.push_back('0');
            base = base == 0 ? 8 : base;
        }
    }
    if (base == 0) base = 10;
    while (isDigitOf(input.peek(), base)) input.takeTo(token);
}

int baseOf(wchar_t letter) {
    switch (letter) {
        case L'i':
            return 0;
        case L'o':
            return 8;
        case L'x':
        case L'X':
            return 16;
        default:
            return 10;
    }
}

/// Reads one format.
class Scanner {
public:
    Scanner(Input input, Arguments& arguments) : _input(input), _arguments(arguments) {}

    int scan(const wchar_t* format) {
        Outcome outcome = Outcome::goOn;
        while (*format != 0 && outcome == Outcome::goOn) outcome = step(format);
        _input.pushBack();
        return outcome == Outcome::inputEnds && _converted == 0 ? -1 : _converted;
    }

private:
    enum class Outcome { goOn, mismatch, inputEnds };

    Outcome step(const wchar_t*& format);
    Outcome matchLiteral(wchar_t c);
    Outcome convert(const Directive& directive);
    Outcome readInteger(const Directive& directive);
    Outcome readReal(const Directive& directive);
    template <class Matches>
    Outcome readText(const Directive& directive, bool terminates, Matches matches);

    template <class T>
    Outcome store(const Directive& directive, bool isValid, T value) {
        if (!isValid) return Outcome::mismatch;
        if (!directive.suppress) {
            *_arguments.next<T*>() = value;
            ++_converted;
        }
        return Outcome::goOn;
    }
    template <class T>
    Outcome storeInteger(const Directive& directive, const std::string& token, int base) {
        T value{};
        const bool isValid = convertInteger(token, base, value);
        return store(directive, isValid, value);
    }
    template <class T>
    Outcome storeReal(const Directive& directive, const std::string& token) {
        T value{};
        const bool isValid = convertReal(token, value);
        return store(directive, isValid, value);
    }

    Input _input;
    Arguments& _arguments;
    int _converted = 0;
};

Scanner::Outcome Scanner::step(const wchar_t*& format) {
    const wchar_t c = *format++;
    if (isWhiteSpace(static_cast<int>(c))) {
        _input.skipWhiteSpace();
        return Outcome::goOn;
    }
    if (c != L'%') return matchLiteral(c);
    Directive directive;
    format = parseDirective(format, directive);
    if (directive.skipsWhiteSpace()) _input.skipWhiteSpace();
    if (directive.letter == L'%') return matchLiteral(L'%');
    if (directive.letter == L'n') {
        *_arguments.next<int*>() = _input.consumed();
        return Outcome::goOn;
    }
    if (_input.peek() < 0) return Outcome::inputEnds;
    _input.setField(directive.fieldWidth());
    const Outcome outcome = convert(directive);
    _input.endField();
    return outcome;
}

Scanner::Outcome Scanner::matchLiteral(wchar_t c) {
    if (_input.peek() < 0) return Outcome::inputEnds;
    return _input.takeIf(static_cast<int>(c)) ? Outcome::goOn : Outcome::mismatch;
}

Scanner::Outcome Scanner::convert(const Directive& directive) {
    switch (directive.letter) {
        // Numbers.
        case L'd':
        case L'i':
        case L'u':
        case L'o':
        case L'x':
        case L'X':
            return readInteger(directive);
        case L'e':
        case L'E':
        case L'f':
        case L'F':
        case L'g':
        case L'G':
            return readReal(directive);
        // Texts: a word, characters of a set, a number of characters.
        case L's':
            return readText(directive, true, [](int c) { return !isWhiteSpace(c); });
        case L'[':
            return readText(directive, true, [&](int c) { return directive.setHolds(c); });
        case L'c':
            if (directive.width == 0) _input.setField(1);
            return readText(directive, false, [](int) { return true; });
        default:
            return Outcome::mismatch;
    }
}

Scanner::Outcome Scanner::readInteger(const Directive& directive) {
    std::string token;
    int base = baseOf(directive.letter);
    collectInteger(_input, token, base);
    const bool isSigned = directive.letter == L'd' || directive.letter == L'i';
    if (directive.modifier == L'h') {
        return isSigned ? storeInteger<std::int16_t>(directive, token, base)
                        : storeInteger<std::uint16_t>(directive, token, base);
    }
    return isSigned ? storeInteger<std::int32_t>(directive, token, base)
                    : storeInteger<std::uint32_t>(directive, token, base);
}

Scanner::Outcome Scanner::readReal(const Directive& directive) {
    std::string token;
    if (!collectReal(_input, token)) return Outcome::mismatch;
    return directive.modifier == L'l' ? storeReal<double>(directive, token) : storeReal<float>(directive, token);
}

template <class Matches>
Scanner::Outcome Scanner::readText(const Directive& directive, bool terminates, Matches matches) {
    if (!matches(_input.peek())) return Outcome::mismatch;
    wchar_t* out = directive.suppress ? nullptr : _arguments.next<wchar_t*>();
    for (int c = _input.peek(); c >= 0 && matches(c); c = _input.peek()) {
        if (out) *out++ = static_cast<wchar_t>(c);
        _input.take();
    }
    if (!out) return Outcome::goOn;
    if (terminates) *out = 0;
    ++_converted;
    return Outcome::goOn;
}

/// Reads "%f" or "%d" alone, with which files of numbers are read, where the window holds all of the number.
bool readSingle(RnCharInput& input, wchar_t letter, void* target) {
    if (letter == L'f') return readInWindow(input, *static_cast<float*>(target));
    return letter == L'd' && readInWindow(input, *static_cast<std::int32_t*>(target));
}

// Not inlined: their frames would cost the short way as much as a number.

__attribute__((noinline)) int scanAny(const Input& input, const wchar_t* format, Arguments& arguments) {
    return Scanner(input, arguments).scan(format);
}

/// Reads the same from any device, character by character.
__attribute__((noinline)) int scanSingle(RnCharInput& input, const wchar_t* format, Arguments& arguments,
                                         void* target) {
    const bool isFloat = format[1] == L'f';
    const NumberStart start(input, isFloat);
    if (isFloat ? start.convert(*static_cast<float*>(target))
                : start.convert(*static_cast<std::int32_t*>(target))) {
        input.ungetChar(start.ahead);
        return 1;
    }
    return scanAny(Input(input, start), format, arguments);
}

}  // namespace

int RnStream::formattedRead(const wchar_t* format, ...) {
    RnCharInput& chars = _state->chars();
    void* single = nullptr;
    if (format[0] == L'%' && (format[1] == L'f' || format[1] == L'd') && format[2] == 0) {
        std::va_list argument;
        va_start(argument, format);
        single = va_arg(argument, void*);
        va_end(argument);
        if (readSingle(chars, format[1], single)) return 1;
    }
    Arguments arguments;
    va_start(arguments.list, format);
    const int count =
        single ? scanSingle(chars, format, arguments, single) : scanAny(Input(chars), format, arguments);
    va_end(arguments.list);
    return count;
}

}  // namespace Ov
