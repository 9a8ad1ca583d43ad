#include <gmock/gmock.h>

#include <bit>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <random>
#include <sstream>
#include <tuple>

#include "support/platform.h"
#include "testObjects.h"

using namespace Ov;

template <class... Args>
std::string printed(const std::string& format, Args... args) {
    std::string text(1000, '\0');
    text.resize(static_cast<std::size_t>(std::snprintf(text.data(), text.size(), format.c_str(), args...)));
    return text;
}

/// What one conversion gives: count, value (exactly, with the sign of a zero) and the input that is left.
template <class T>
std::string outcome(int count, T value, const std::string& rest) {
    return printed("%d %.17g ", count, static_cast<double>(value)) + rest;
}

template <class T>
std::string readFrom(RnRef<RnBufferedIO> device, const wchar_t* format, T value = 77) {
    const int count = RnStream(device.get(), RnStream::Form::text).formattedRead(format, &value);
    return outcome(count, value, readRest(*device));
}

/// Memory, and devices that show a byte at a time or none.
std::vector<RnRef<RnBufferedIO>> devicesOf(const std::string& bytes) {
    return {rnCreate<RnMemoryBuffer>(bytes), rnCreate<DripDevice>(bytes), rnCreate<PlainDevice>(bytes)};
}

/// Reads the input of each row "input|value|rest" as a whole, byte by byte, and with white space and more around
/// it. What has no value does not convert.
template <class T>
void expectRows(const wchar_t* format, std::initializer_list<const char*> rows) {
    for (const char* row : rows) {
        const auto row3 = cells(row);
        const T value = row3[1].empty() ? T(77) : static_cast<T>(std::strtod(row3[1].c_str(), nullptr));
        for (const char* more : {"", "\n;"}) {
            const std::string input = (*more ? " \t\r\n\v\f" : "") + row3[0] + more;
            const std::string expected = outcome(!row3[1].empty(), value, row3[2] + more);
            for (const auto& device : devicesOf(input)) EXPECT_EQ(readFrom<T>(device, format), expected) << row;
        }
    }
}

TEST(FormattedRead, Numbers) {
    expectRows<float>(
        L"%f", {"-.25x|-0.25|x", "+7.|7|", "-0|-0|", "12.5.3|12.5|.3", "7,8|7|,8", "1e3e3|1000|e3", "1E+02|100|",
                "0x10|0|x10", "0.00000000000000000000000000000000000000000000000000012e52|1.2|",
                "3.4028235e38|3.4028235e38|", "1e39||", "1000000000000000000000000000000000000000e0||",
                "-1e99999999999999999999||", "1e-45|1e-45|", "-1e-50|-0|", "1e-99999999999999999999|0|",
                "0e99999999999999999999|0|"});
    // Midway between two floats and just above it; what is consumed because it could have been a number.
    expectRows<float>(L"%f",
                      {"16777217|16777216|", "16777219|16777220|", "16777217.000001|16777218|",
                       "16777217.000000000000000000000001|16777218|", "1e||", "1e+||", "1e-x||x", "-||", ".||",
                       "-.e5||e5", "+-1||-1", "--1||-1", "e5||e5", "nan||nan", "-inf||inf", "\2401||\2401"});
    expectRows<float>(L"%3f", {"12345|123|45", "1.25|1.2|5", "1e55|1e5|5", "12e5||5", "-1|-1|"});
    expectRows<double>(
        L"%lg", {"0.1|0.1|", "9007199254740993|9007199254740992|", "1e-400|0|", "1e400||", "1e-323|1e-323|"});
    expectRows<std::int32_t>(L"%d", {"-2147483648|-2147483648|", "2147483648||", "+5|5|", "007|7|", "73.0|73|.0",
                                     "0x1F|0|x1F", "-||", "+-1||-1", "x||x"});
    expectRows<std::int16_t>(L"%hd", {"-32768|-32768|", "32768||"});
    expectRows<std::uint16_t>(L"%hx", {"0x1fG|31|G", "FFFF|65535|", "10000||", "0x||", "0xg||g", "0|0|"});
    expectRows<std::uint32_t>(L"%u", {"4294967295|4294967295|", "-1||"});
    expectRows<std::int32_t>(L"%i", {"010|8|", "-0x10|-16|", "08|0|8", "9|9|"});
}

/// Every way in gives what the C library gives.
void expectAsTheLibraryReads(const std::string& text) {
    const float single = std::strtof(text.c_str(), nullptr);
    const auto expected = std::isfinite(single) ? outcome(1, single, " .") : outcome(0, 77, " .");
    for (const auto& device : devicesOf(text + " .")) EXPECT_EQ(readFrom<float>(device, L"%f"), expected) << text;
    EXPECT_EQ(readFrom<double>(rnCreate<RnMemoryBuffer>(text + " ."), L"%lf"),
              outcome(1, std::strtod(text.c_str(), nullptr), " ."));
}

/// Numbers of many shapes, decimals of floats, and the exact midpoints between two floats.
TEST(FormattedRead, NumbersAreCorrectlyRounded) {
    std::mt19937 random(1);
    for (int i = 0; i < 8000 && !HasFailure(); ++i) {
        std::string text = random() % 2 ? "-" : "";
        for (auto n = 1 + random() % (random() % 8 ? 10 : 40); n > 0; --n) {
            text += static_cast<char>('0' + random() % 10);
            if (n % 5 == 3 && text.find('.') == std::string::npos) text += '.';
        }
        if (random() % 3 == 0) text += "e" + std::to_string(static_cast<int>(random() % 90) - 50);
        expectAsTheLibraryReads(text);

        const auto bits = 0x3000'0000U + static_cast<std::uint32_t>(random() % 0x2000'0000U);
        const auto value = static_cast<double>(std::bit_cast<float>(bits));
        const auto above = static_cast<double>(std::bit_cast<float>(bits + 1));
        expectAsTheLibraryReads(printed("%.9g", value));
        expectAsTheLibraryReads(printed("%.60f", (value + above) / 2));
    }
}

TEST(FormattedRead, Texts) {
    // Format, input, count, text and rest.
    for (const char* row :
         {"%3s|  Onward|1|Onw|ard", "%s|a\xA0\xFF b|1|a\u00A0\u00FF| b", "%s|  |-1|?|", "%f| \n|-1|?|",
          "%d||-1|?|", "%80[^\r\n]| two words\r\n|1| two words|\r\n", "%80[^\r\n]|\nnext|0|?|\nnext",
          "%80[^\r\n]||-1|?|", "%[]x-]|x]-[|1|x]-|[", "%[^]a-c]|xyb]|1|xy|b]", "%2c| \nz|1| \n|z",
          "%*s %s|one two|1|two|", "%*2d%s|12345|1|345|", "In: %s\n|In:Out \n\n x|1|Out|x",
          "  50%% %s|50 \t% y|1|y|", "In: %s|Im: y|0|?|m: y", "In: %s|In|-1|?|"}) {
        const auto c = cells(row);
        for (const auto& device : devicesOf(c[1])) {
            wchar_t text[90] = L"?";
            RnStream stream(device.get(), RnStream::Form::binary);
            const std::string count = std::to_string(stream.formattedRead(fromUtf8(c[0]).c_str(), text));
            EXPECT_THAT(row, testing::EndsWith("|" + count + "|" + toUtf8(text) + "|" + readRest(*device)));
        }
    }
}

TEST(FormattedRead, SeveralFieldsStopAtTheFirstThatFails) {
    const auto device = rnCreate<RnMemoryBuffer>("\nVersion 1, Release 0x2f 2.5 x");
    RnStream stream(device.get(), RnStream::Form::text);
    stream.pendingSeparator = true;  // is consumed first
    int version = 0, release = 0, length = 0;
    float size = 0;
    EXPECT_EQ(stream.formattedRead(L"Version %d, Release %i%n%g %d", &version, &release, &length, &size, &version),
              3);
    EXPECT_EQ((std::tuple{version, release, length, size}), (std::tuple{1, 0x2F, 23, 2.5F}));
    EXPECT_EQ(readRest(*device), "x");
}

template <class... Args>
std::string written(const std::string& format, Args... args) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream stream(device.get(), RnStream::Form::text);
    stream.column = 75;  // neither is touched
    stream.pendingSeparator = true;
    const int count = stream.formattedWrite(std::wstring(format.begin(), format.end()).c_str(), args...);
    EXPECT_EQ(count, static_cast<int>(device->bytes().size()));
    EXPECT_TRUE(stream.column == 75 && stream.pendingSeparator);
    return device->bytes();
}

std::string randomDirective(std::mt19937& random, const std::string& letters) {
    std::string directive = "%";
    for (const char flag : {'-', '+', ' ', '#', '0'}) directive.append(random() % 3 == 0, flag);
    if (random() % 2) directive += std::to_string(1 + random() % 30);
    if (random() % 2) directive += random() % 5 ? "." + std::to_string(random() % 30) : ".";
    directive.append(letters[0] == 'd' && random() % 4 == 0, 'h');
    return directive + letters[random() % letters.size()];
}

TEST(FormattedWrite, NumbersAreWhatPrintfWrites) {
    std::mt19937 random(3);
    const double odd[] = {0.0, -0.0, INFINITY, -INFINITY, NAN, 9.9999995, 0.0001, 0.00009999995, 1e21, 1.7e308};
    const int edges[] = {0, -1, 1, std::numeric_limits<int>::min(), std::numeric_limits<int>::max(), 40000};
    std::uint64_t digest = 0;
    const auto expectPrinted = [&](const std::string& directive, auto value) {
        const std::string text = written(directive, value);
        if (printfIsExact) {
            ASSERT_EQ(text, printed(directive, value)) << directive;
        }
        for (const char c : text) digest = (digest ^ static_cast<unsigned char>(c)) * 0x100000001B3;
    };
    for (int i = 0; i < 8000; ++i) {
        const auto bits = static_cast<std::uint32_t>(random());
        // Floats of every magnitude, ties (which go to the even digit), decimals, and what no float holds.
        for (const double value :
             {static_cast<double>(std::bit_cast<float>(bits)), (bits % 100000) / 64.0,
              static_cast<double>(static_cast<float>(bits % 1000000) / 100),
              std::ldexp(bits % 100000, static_cast<int>(random() % 60) - 40), odd[bits % std::size(odd)]}) {
            expectPrinted(randomDirective(random, "feEFgG"), value);
            expectPrinted("%." + std::to_string(bits % 6) + "f", value);
        }
        for (const int value : {edges[bits % 6], static_cast<int>(bits % 1000) - 500})
            expectPrinted(randomDirective(random, "diuxXo"), value);
    }
    EXPECT_EQ(digest, 16363591895736590482U);  // the same texts on every platform
}

TEST(FormattedWrite, TextsWidthsAndCounts) {
    EXPECT_EQ(written("TILT=%*s|%-*s|%*s", 6, L"a.tlt", 4, L"b", -3, L"c"), "TILT= a.tlt|b   |c  ");
    EXPECT_EQ(written("%8s|%4d%4d|%.2s", L" ", 1, -345, L"abc"), "        |   1-345|ab");
    EXPECT_EQ(written("%.*f|%.*g|%c%3c%%", 1, 0.25, -1, 0.1, L'x', 0xE9), "0.2|0.1|x  \xE9%");
    EXPECT_EQ(written("100%% %s%s", L"\u00B5\u4E2D", static_cast<const wchar_t*>(nullptr)), "100% \xB5?");
    int before = 0, after = 0;
    EXPECT_EQ(written("ab%n %.2f%n|", &before, 1.005, &after), "ab 1.00|");
    EXPECT_THAT((std::tuple{before, after}), testing::FieldsAre(2, 7));
}
