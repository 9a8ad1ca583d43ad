#include <algorithm>
#include <array>
#include <bit>
#include <charconv>
#include <type_traits>
#include <utility>

#include "components/support/textClass.h"
#include "host/standIn/streamState.h"

// The typed operations of streams.

namespace Ov {

namespace {

constexpr const char* valuesSource = "host/componentManager/streamValues";
constexpr std::size_t longestNumber = 1024;

/// The numbers that stand for a value: `Text` has all values of T, `Binary` is what fits the stream.
template <class T, class T1 = T, class T2 = T1>
struct NumberTypes {
    using Text = T1;
    using Binary = T2;
};
template <class T>
struct Number : NumberTypes<T> {};
template <>
struct Number<bool> : NumberTypes<bool, std::uint8_t> {};
template <>
struct Number<char> : NumberTypes<char, std::uint8_t> {};
template <>
struct Number<wchar_t> : NumberTypes<wchar_t, std::uint32_t, std::uint16_t> {};
template <>
struct Number<long> : NumberTypes<long, long, std::int32_t> {};
template <>
struct Number<unsigned long> : NumberTypes<unsigned long, unsigned long, std::uint32_t> {};

template <std::size_t size>
using Bits = std::conditional_t<
    size == 1, std::uint8_t,
    std::conditional_t<size == 2, std::uint16_t, std::conditional_t<size == 4, std::uint32_t, std::uint64_t>>>;

[[noreturn]] void failRead(int line) { throw RnStreamEx::ExReadError(valuesSource, line, "value stream"); }
[[noreturn]] void failWrite(int line) { throw RnStreamEx::ExWriteError(valuesSource, line, "value stream"); }

/// The same value in another type; false when that cannot hold it.
template <class To, class From>
bool convert(From from, To& to) {
    to = static_cast<To>(from);
    if constexpr (std::is_floating_point_v<From>) {
        return true;
    } else {
        return static_cast<From>(to) == from;
    }
}

// Binary form.

void readRaw(RnStream& stream, void* data, int count) {
    if (rnReadBytes(stream.device(), data, count) < count) failRead(__LINE__);
}

template <class B>
void writeLittle(RnStream& stream, B value) {
    std::array<char, sizeof(B)> bytes;
    auto bits = static_cast<std::uint64_t>(std::bit_cast<Bits<sizeof(B)>>(value));
    for (char& byte : bytes) {
        byte = static_cast<char>(bits);
        bits >>= 8;
    }
    stream.state().writeBytes({bytes.data(), bytes.size()});
}

template <class B>
B readLittle(RnStream& stream) {
    std::array<unsigned char, sizeof(B)> bytes;
    readRaw(stream, bytes.data(), static_cast<int>(bytes.size()));
    std::uint64_t bits = 0;
    for (std::size_t i = bytes.size(); i-- > 0;) bits = bits << 8 | bytes[i];
    return std::bit_cast<B>(static_cast<Bits<sizeof(B)>>(bits));
}

// Text form.

void writeTextItem(RnStream& stream, const std::wstring& text) {
    if (!std::in_range<int>(text.size())) failWrite(__LINE__);
    writeItem(stream, text.data(), static_cast<int>(text.size()));
    stream.pendingSeparator = true;
}

/// The first character of the next item. A separator that is due is part of the white space before it.
int startItem(RnStream& stream) {
    stream.pendingSeparator = false;
    int c = stream.state().chars().getChar();
    while (isWhiteSpace(c)) c = stream.state().chars().getChar();
    if (c < 0) failRead(__LINE__);
    return c;
}

template <class N>
void writeNumber(RnStream& stream, N number) {
    char buffer[32];
    const char* end = std::to_chars(buffer, buffer + sizeof buffer, number).ptr;
    wchar_t text[sizeof buffer];
    std::transform(static_cast<const char*>(buffer), end, text, [](char c) { return static_cast<wchar_t>(c); });
    writeItem(stream, text, static_cast<int>(end - buffer));
    stream.pendingSeparator = true;
}

template <class N>
N readNumber(RnStream& stream) {
    std::string token;
    int c = startItem(stream);
    for (; c >= 0 && !isWhiteSpace(c); c = stream.state().chars().getChar()) {
        if (token.size() == longestNumber) failRead(__LINE__);
        token.push_back(static_cast<char>(c));
    }
    stream.state().chars().ungetChar(c);
    stream.pendingSeparator = true;
    N number{};
    const char* end = token.data() + token.size();
    const auto [stop, error] = std::from_chars(token.data(), end, number);
    if (error != std::errc{} || stop != end) failRead(__LINE__);
    return number;
}

// Strings, as UTF-16 units in both forms.

template <class F>
void forUnits(const std::wstring& text, F unit) {
    for (wchar_t c : text) {
        const auto code = static_cast<std::uint32_t>(c);
        if (code > 0x10FFFF) failWrite(__LINE__);
        if (code > 0xFFFF) unit(static_cast<char16_t>(0xD7C0 + (code >> 10)));
        unit(static_cast<char16_t>(code > 0xFFFF ? 0xDC00 + (code & 0x3FF) : code));
    }
}

void appendUnit(std::wstring& text, char16_t unit) {
    if constexpr (sizeof(wchar_t) > 2) {
        if ((unit & 0xFC00) == 0xDC00 && !text.empty() && text.back() >= 0xD800 && text.back() < 0xDC00) {
            text.back() = static_cast<wchar_t>(((text.back() - 0xD800) << 10) + (unit - 0xDC00) + 0x10000);
            return;
        }
    }
    text.push_back(static_cast<wchar_t>(unit));
}

void writeBinaryText(RnStream& stream, const std::wstring& value) {
    std::string bytes;
    forUnits(value, [&](char16_t unit) {
        bytes.push_back(static_cast<char>(unit & 0xFF));
        bytes.push_back(static_cast<char>(unit >> 8));
    });
    if (!std::in_range<int>(bytes.size())) failWrite(__LINE__);
    writeLittle(stream, static_cast<std::uint32_t>(bytes.size() / 2));
    stream.state().writeBytes(bytes);
}

/// Reads block by block: the length is taken for true only as far as units arrive.
std::wstring readBinaryText(RnStream& stream) {
    std::wstring text;
    std::array<unsigned char, 4096> block;
    for (auto left = readLittle<std::uint32_t>(stream); left > 0;) {
        const auto units = std::min<std::size_t>(left, block.size() / 2);
        readRaw(stream, block.data(), static_cast<int>(2 * units));
        for (std::size_t i = 0; i < 2 * units; i += 2) {
            appendUnit(text, static_cast<char16_t>(block[i] | block[i + 1] << 8));
        }
        left -= static_cast<std::uint32_t>(units);
    }
    return text;
}

void writeQuoted(RnStream& stream, const std::wstring& value) {
    std::wstring text = L"\"";
    forUnits(value, [&](char16_t unit) {
        if (unit < 0x20 || unit > 0x7E) {
            text += L"\\u";
            for (int shift = 12; shift >= 0; shift -= 4) text.push_back(L"0123456789abcdef"[unit >> shift & 15]);
            return;
        }
        if (unit == u'"' || unit == u'\\') text.push_back(L'\\');
        text.push_back(static_cast<wchar_t>(unit));
    });
    text.push_back(L'"');
    writeTextItem(stream, text);
}

char16_t readEscape(RnStream& stream) {
    const int c = stream.state().chars().getChar();
    if (c == '"' || c == '\\') return static_cast<char16_t>(c);
    if (c != 'u') failRead(__LINE__);
    char digits[4];
    for (char& digit : digits) digit = static_cast<char>(stream.state().chars().getChar());
    std::uint16_t unit = 0;
    if (std::from_chars(digits, digits + 4, unit, 16).ptr != digits + 4) failRead(__LINE__);
    return static_cast<char16_t>(unit);
}

std::wstring readQuoted(RnStream& stream) {
    if (startItem(stream) != '"') failRead(__LINE__);
    std::wstring text;
    for (int c = stream.state().chars().getChar(); c != '"'; c = stream.state().chars().getChar()) {
        if (c < 0) failRead(__LINE__);
        appendUnit(text, c == '\\' ? readEscape(stream) : static_cast<char16_t>(c));
    }
    stream.pendingSeparator = true;
    return text;
}

// One value of any type.

template <class T>
void writeValue(RnStream& stream, const T& value) {
    const auto number = static_cast<typename Number<T>::Text>(value);
    if (stream.isTextStream()) return writeNumber(stream, number);
    typename Number<T>::Binary binary;
    if (!convert(number, binary)) failWrite(__LINE__);
    writeLittle(stream, binary);
}

void writeValue(RnStream& stream, const std::wstring& value) {
    stream.isTextStream() ? writeQuoted(stream, value) : writeBinaryText(stream, value);
}

template <class T>
void readValue(RnStream& stream, T& value) {
    using Text = typename Number<T>::Text;
    const Text number = stream.isTextStream() ? readNumber<Text>(stream)
                                              : static_cast<Text>(readLittle<typename Number<T>::Binary>(stream));
    T result;
    if (!convert(number, result)) failRead(__LINE__);
    value = result;
}

void readValue(RnStream& stream, std::wstring& value) {
    value = stream.isTextStream() ? readQuoted(stream) : readBinaryText(stream);
}

}  // namespace

#define OV_STREAM_VALUE(T)                                              \
    void RnStream::write(const T& value, int count) {                   \
        for (int i = 0; i < count; ++i) writeValue(*this, (&value)[i]); \
    }                                                                   \
    RnStream& RnStream::operator<<(T value) {                           \
        writeValue(*this, value);                                       \
        return *this;                                                   \
    }                                                                   \
    int RnStream::read(T& value, int count) {                           \
        for (int i = 0; i < count; ++i) readValue(*this, (&value)[i]);  \
        return count > 0 ? count : 0;                                   \
    }                                                                   \
    RnStream& RnStream::operator>>(T& value) {                          \
        readValue(*this, value);                                        \
        return *this;                                                   \
    }
// The interface takes values. NOLINTNEXTLINE(performance-unnecessary-value-param)
OV_STREAM_TYPES(OV_STREAM_VALUE)
#undef OV_STREAM_VALUE

}  // namespace Ov
