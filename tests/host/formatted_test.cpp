#include <gmock/gmock.h>

#include <array>
#include <bit>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <limits>
#include <random>

#include "testDevices.h"

namespace Ov {
namespace {

constexpr float inf = std::numeric_limits<float>::infinity();

/// What one conversion gave, and the input that it left.
template <class T>
struct Reading {
    int count;
    T value;
    std::string rest;

    friend bool operator==(const Reading& a, const Reading& b) {
        return a.count == b.count && a.value == b.value && a.rest == b.rest &&
               std::signbit(static_cast<double>(a.value)) == std::signbit(static_cast<double>(b.value));
    }
    friend std::ostream& operator<<(std::ostream& out, const Reading& r) {
        return out << r.count << " of value " << r.value << ", left \"" << r.rest << '"';
    }
};

template <class T>
Reading<T> readFrom(RnRef<RnBufferedIO> device, const wchar_t* format, T value) {
    RnStream stream(device.get(), RnStream::Form::text);
    const int count = stream.formattedRead(format, &value);
    return {count, value, readRest(*device)};
}

template <class T>
struct Row {
    const char* input;
    Reading<T> expected;
};

/// Reads each input as a whole, byte by byte, and with more input behind it.
template <class T, std::size_t n>
void expectRows(const wchar_t* format, const Row<T> (&rows)[n]) {
    for (const auto& [input, expected] : rows) {
        SCOPED_TRACE(input);
        const T untouched = static_cast<T>(-7);
        EXPECT_EQ(readFrom(rnCreate<RnMemoryBuffer>(input), format, untouched), expected);
        EXPECT_EQ(readFrom(rnCreate<DripDevice>(input), format, untouched), expected);
        if (expected.count < 0) continue;
        const std::string more = std::string(input) + "\n;";
        const Reading<T> before{expected.count, expected.value, expected.rest + "\n;"};
        EXPECT_EQ(readFrom(rnCreate<RnMemoryBuffer>(more), format, untouched), before);
        EXPECT_EQ(readFrom(rnCreate<DripDevice>(more), format, untouched), before);
    }
}

TEST(FormattedRead, Floats) {
    const Row<float> rows[] = {
        {"1.5", {1, 1.5F, ""}},
        {" \t\r\n\v\f-.25x", {1, -.25F, "x"}},
        {"+7.", {1, 7, ""}},
        {"-0", {1, -0.0F, ""}},
        {"12.5.3", {1, 12.5F, ".3"}},
        {"7,8", {1, 7, ",8"}},
        {"1e3e3", {1, 1000, "e3"}},
        {"1E+02", {1, 100, ""}},
        {"0x10", {1, 0, "x10"}},
        {"123456789012345678901234567890", {1, 123456789012345678901234567890.F, ""}},
        {"0.00000000000000000000000000000000000000000000000000012e52", {1, 1.2F, ""}},
        // Midway between two floats, and just above it.
        {"16777217", {1, 16777216, ""}},
        {"16777219", {1, 16777220, ""}},
        {"16777217.000000000000000000000001", {1, 16777218, ""}},
        {"16777217.000001", {1, 16777218, ""}},
        // Too small is 0, or the nearest subnormal.
        {"1e-50", {1, 0, ""}},
        {"-1e-50", {1, -0.0F, ""}},
        {"1e-99999999999999999999", {1, 0, ""}},
        {"0e99999999999999999999", {1, 0, ""}},
        {"1e-45", {1, std::numeric_limits<float>::denorm_min(), ""}},
        {"1e-40", {1, 1e-40F, ""}},
        {"3.4028235e38", {1, std::numeric_limits<float>::max(), ""}},
        // What does not convert is consumed as far as it could have been a number.
        {"1e39", {0, -7, ""}},
        {"-1e99999999999999999999", {0, -7, ""}},
        {"1000000000000000000000000000000000000000e0", {0, -7, ""}},
        {"1e", {0, -7, ""}},
        {"1e+", {0, -7, ""}},
        {"1e-x", {0, -7, "x"}},
        {"-", {0, -7, ""}},
        {".", {0, -7, ""}},
        {"-.e5", {0, -7, "e5"}},
        {"+-1", {0, -7, "-1"}},
        {"--1", {0, -7, "-1"}},
        {"e5", {0, -7, "e5"}},
        {"nan", {0, -7, "nan"}},
        {"-inf", {0, -7, "inf"}},
        {"\xA0"
         "1",
         {0, -7,
          "\xA0"
          "1"}},
        {"", {-1, -7, ""}},
        {" \n", {-1, -7, ""}},
    };
    expectRows(L"%f", rows);
    expectRows(L"%g", rows);
}

TEST(FormattedRead, FieldWidthsCutNumbers) {
    const Row<float> rows[] = {
        {"  12345", {1, 123, "45"}}, {"1.25", {1, 1.2F, "5"}}, {"1e55", {1, 1e5F, "5"}},
        {"12e5", {0, -7, "5"}},      {"-1", {1, -1, ""}},
    };
    expectRows(L"%3f", rows);
}

TEST(FormattedRead, Doubles) {
    const Row<double> rows[] = {
        {"0.1", {1, 0.1, ""}},           {"9007199254740993", {1, 9007199254740992, ""}},
        {"1e-400", {1, 0, ""}},          {"1e400", {0, -7, ""}},
        {"4.9e-324", {1, 4.9e-324, ""}}, {"1e39", {1, 1e39, ""}},
    };
    expectRows(L"%lg", rows);
}

TEST(FormattedRead, Integers) {
    const Row<std::int32_t> decimal[] = {
        {"12", {1, 12, ""}},         {" -2147483648", {1, std::numeric_limits<std::int32_t>::min(), ""}},
        {"+5", {1, 5, ""}},          {"007", {1, 7, ""}},
        {"73.0", {1, 73, ".0"}},     {"0x1F", {1, 0, "x1F"}},
        {"2147483648", {0, -7, ""}}, {"99999999999999999999999", {0, -7, ""}},
        {"-", {0, -7, ""}},          {"+-1", {0, -7, "-1"}},
        {"x", {0, -7, "x"}},         {"", {-1, -7, ""}},
    };
    expectRows(L"%d", decimal);
    const Row<std::int16_t> shorts[] = {{"-32768", {1, -32768, ""}}, {"32768", {0, -7, ""}}};
    expectRows(L"%hd", shorts);
    const Row<std::uint16_t> shortHex[] = {
        {"0x1fG", {1, 0x1f, "G"}}, {"FFFF", {1, 0xFFFF, ""}}, {"10000", {0, 0xFFF9, ""}},
        {"0x", {0, 0xFFF9, ""}},   {"0xg", {0, 0xFFF9, "g"}}, {"0", {1, 0, ""}},
    };
    expectRows(L"%hx", shortHex);
    const Row<std::uint32_t> numbers[] = {{"4294967295", {1, 0xFFFFFFFF, ""}}, {"-1", {0, 0xFFFFFFF9, ""}}};
    expectRows(L"%u", numbers);
    const Row<std::int32_t> anyBase[] = {{"010", {1, 8, ""}}, {"-0x10", {1, -16, ""}}, {"08", {1, 0, "8"}}};
    expectRows(L"%i", anyBase);
}

/// Every way in gives what the C library gives for numbers of many shapes.
TEST(FormattedRead, NumbersAreCorrectlyRounded) {
    std::mt19937_64 random(1);
    for (int i = 0; i < 40000; ++i) {
        std::string text = random() % 2 ? "-" : "";
        for (auto n = 1 + random() % (random() % 8 ? 10 : 40); n > 0; --n) {
            text += static_cast<char>('0' + random() % 10);
            if (n % 5 == 3 && text.find('.') == std::string::npos) text += '.';
        }
        if (random() % 3 == 0) text += "e" + std::to_string(static_cast<int>(random() % 90) - 50);
        const float expected = std::strtof(text.c_str(), nullptr);
        const bool held = std::isfinite(expected);
        const Reading<float> single{held, held ? expected : -7, " ."};
        const auto ref = std::strtod(text.c_str(), nullptr);
        text += " .";
        ASSERT_EQ(readFrom(rnCreate<RnMemoryBuffer>(text), L"%f", -7.F), single) << text;
        ASSERT_EQ(readFrom(rnCreate<DripDevice>(text), L"%f", -7.F), single) << text;
        ASSERT_EQ(readFrom(rnCreate<RnMemoryBuffer>(text), L"%lf", -7.), (Reading<double>{1, ref, " ."})) << text;
    }
}

/// A shortest decimal of a float, and the exact midpoint to the next float, round as they should.
TEST(FormattedRead, FloatsAndTheirMidpoints) {
    std::mt19937 random(2);
    for (int i = 0; i < 20000; ++i) {
        const auto bits = 0x3000'0000U + static_cast<std::uint32_t>(random() % 0x2000'0000U);
        const auto value = std::bit_cast<float>(bits);
        const auto above = std::bit_cast<float>(bits + 1);
        std::array<char, 200> text;
        std::snprintf(text.data(), text.size(), "%.9g ", static_cast<double>(value));
        EXPECT_EQ(readFrom(rnCreate<RnMemoryBuffer>(text.data()), L"%f", 0.F).value, value) << text.data();
        std::snprintf(text.data(), text.size(), "%.60f ",
                      (static_cast<double>(value) + static_cast<double>(above)) / 2);
        EXPECT_EQ(readFrom(rnCreate<RnMemoryBuffer>(text.data()), L"%f", 0.F).value, bits % 2 ? above : value)
            << text.data();
    }
}

TEST(FormattedRead, Texts) {
    struct Case {
        const wchar_t* format;
        const char* input;
        int count;
        const wchar_t* text;
        const char* rest;
    };
    const Case cases[] = {
        {L"%3s", "  Onward", 1, L"Onw", "ard"},
        {L"%s", "a\xA0\xFF b", 1, L"a\u00A0\u00FF", " b"},
        {L"%s", "  ", -1, L"?", ""},
        {L"%80[^\r\n]", " two words\r\n", 1, L" two words", "\r\n"},
        {L"%4[^\r\n]", "123456", 1, L"1234", "56"},
        {L"%80[^\r\n]", "\nnext", 0, L"?", "\nnext"},
        {L"%80[^\r\n]", "", -1, L"?", ""},
        {L"%[a-cx]", "abxcd", 1, L"abxc", "d"},
        {L"%[]x-]", "x]-[", 1, L"x]-", "["},
        {L"%[^]x]", "ab]", 1, L"ab", "]"},
        {L"%2c", " \nz", 1, L" \n", "z"},
        {L"%*s %s", "one two", 1, L"two", ""},
        {L"%*2d%s", "12345", 1, L"345", ""},
        {L"In: %s\n", "In:Out \n\n x", 1, L"Out", "x"},
        {L"  50%% %s", "50 \t% y", 1, L"y", ""},
        {L"In: %s", "Im: y", 0, L"?", "m: y"},
        {L"In: %s", "In", -1, L"?", ""},
    };
    for (const Case& c : cases) {
        SCOPED_TRACE(c.input);
        for (const RnRef<RnBufferedIO>& device : {RnRef<RnBufferedIO>(rnCreate<RnMemoryBuffer>(c.input)),
                                                  RnRef<RnBufferedIO>(rnCreate<DripDevice>(c.input))}) {
            std::array<wchar_t, 90> text;
            text.fill(0);
            text[0] = L'?';
            RnStream stream(device.get(), RnStream::Form::binary);
            EXPECT_EQ(stream.formattedRead(c.format, text.data()), c.count);
            EXPECT_STREQ(text.data(), c.text);
            EXPECT_EQ(readRest(*device), c.rest);
        }
    }
}

TEST(FormattedRead, SeveralFieldsStopAtTheFirstThatFails) {
    const auto device = rnCreate<RnMemoryBuffer>("Version 1, Release 0x2f 1 2 x");
    RnStream stream(device.get(), RnStream::Form::text);
    int version = 0;
    unsigned release = 0;
    int length = 0;
    EXPECT_EQ(stream.formattedRead(L" Version %d, Release %x%n", &version, &release, &length), 2);
    EXPECT_EQ(version, 1);
    EXPECT_EQ(release, 0x2fU);
    EXPECT_EQ(length, 23);
    float a = 0, b = 0, c = 0;
    EXPECT_EQ(stream.formattedRead(L"%g %g %g", &a, &b, &c), 2);
    EXPECT_EQ(readRest(*device), "x");
    EXPECT_EQ(stream.formattedRead(L"%d", &version), -1);
}

TEST(FormattedRead, ConsumesThePendingSeparatorFirst) {
    const auto device = rnCreate<RnMemoryBuffer>("\n\nline");
    RnStream stream(device.get(), RnStream::Form::text);
    stream.pendingSeparator = true;
    wchar_t text[10];
    EXPECT_EQ(stream.formattedRead(L"%9[^\n]", text), 0);
    EXPECT_FALSE(stream.pendingSeparator);
    EXPECT_EQ(readRest(*device), "\nline");
}

// Writing.

template <class... Args>
std::string written(const std::wstring& format, Args... args) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream stream(device.get(), RnStream::Form::text);
    const int count = stream.formattedWrite(format.c_str(), args...);
    EXPECT_EQ(count, static_cast<int>(device->bytes().size()));
    return device->bytes();
}

template <class... Args>
std::string printed(const std::string& format, Args... args) {
    std::string text(1000, '\0');
    text.resize(static_cast<std::size_t>(std::snprintf(text.data(), text.size(), format.c_str(), args...)));
    return text;
}

std::string randomSpec(std::mt19937& random, const char* flags) {
    std::string spec = "%";
    for (const char* flag = flags; *flag; ++flag) {
        if (random() % 3 == 0) spec += *flag;
    }
    if (random() % 2) spec += std::to_string(1 + random() % 30);
    if (random() % 2) spec += random() % 5 ? "." + std::to_string(random() % 30) : ".";
    return spec;
}

TEST(FormattedWrite, NumbersAreWhatPrintfWrites) {
    std::mt19937 random(3);
    const double odd[] = {0.0,           -0.0,  inf, -inf, NAN,    9.9999995, 0.0001,
                          0.00009999995, 0.125, 2.5, 1e21, 5e-324, 1.7e308};
    const int edges[] = {0, -1, 1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max(), 40000};
    for (int i = 0; i < 30000; ++i) {
        std::string spec = randomSpec(random, "-+ #0");
        const bool isReal = random() % 2;
        if (!isReal && random() % 4 == 0) spec += 'h';
        spec += isReal ? "eEfFgG"[random() % 6] : "diuxXo"[random() % 6];
        const std::wstring wide(spec.begin(), spec.end());
        if (isReal) {
            double value =
                std::ldexp(static_cast<double>(random() % 100000), static_cast<int>(random() % 60) - 40);
            if (random() % 4 == 0) value = odd[random() % std::size(odd)];
            ASSERT_EQ(written(wide, value), printed(spec, value)) << spec;
        } else {
            const int value =
                random() % 3 ? edges[random() % std::size(edges)] : static_cast<int>(random() % 1000) - 500;
            ASSERT_EQ(written(wide, value), printed(spec, value)) << spec;
        }
    }
}

/// Two decimals of floats, as value lists have them: every magnitude, and ties, which go to the even digit.
TEST(FormattedWrite, FloatsAreCorrectlyRounded) {
    std::mt19937 random(4);
    for (int i = 0; i < 30000; ++i) {
        double value = static_cast<double>(std::bit_cast<float>(static_cast<std::uint32_t>(random())));
        if (i % 3 == 0) value = static_cast<double>(random() % 100000) / 64;
        if (i % 3 == 1) value = static_cast<double>(static_cast<float>(random() % 1000000) / 100);
        const std::string spec = "%." + std::to_string(random() % 6) + "f";
        ASSERT_EQ(written(std::wstring(spec.begin(), spec.end()), value), printed(spec, value));
    }
}

TEST(FormattedWrite, TextsWidthsAndCounts) {
    EXPECT_EQ(written(L"TILT=%*s|%-*s|%*s", 6, L"a.tlt", 4, L"b", -3, L"c"), "TILT= a.tlt|b   |c  ");
    EXPECT_EQ(written(L"%8s|%4d%4d|%.2s|%s", L" ", 1, -345, L"abc", static_cast<const wchar_t*>(nullptr)),
              "        |   1-345|ab|");
    EXPECT_EQ(written(L"%.*f|%.*g|%c%3c%%", 1, 0.25, -1, 0.1, L'x', 0xE9), "0.2|0.1|x  \xE9%");
    EXPECT_EQ(written(L"100%% \u20AC %s", L"\u00B5\u4E2D"), "100% ? \xB5?");
    const std::wstring longText(5000, L'z');
    EXPECT_EQ(written(L"%s", longText.c_str()), std::string(5000, 'z'));
    int before = 0, after = 0;
    EXPECT_EQ(written(L"ab%n %.2f%n|", &before, 1.005, &after), "ab 1.00|");
    EXPECT_EQ(before, 2);
    EXPECT_EQ(after, 7);
}

TEST(FormattedWrite, LeavesTheStateOfTheStreamAlone) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream stream(device.get(), RnStream::Form::text);
    stream.column = 75;
    stream.pendingSeparator = true;
    stream.formattedWrite(L"%d\n", 1);
    EXPECT_EQ(stream.column, 75);
    EXPECT_TRUE(stream.pendingSeparator);
    EXPECT_EQ(device->bytes(), "1\n");
}

}  // namespace
}  // namespace Ov
