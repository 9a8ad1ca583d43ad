#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "components/messageFile/message.h"

namespace {

using Ov::formatMessage;

struct FormatCase {
    const wchar_t* text;
    std::wstring expected;
    std::wstring result;
};

template <class... Arguments>
FormatCase format(const wchar_t* text, const wchar_t* expected, Arguments... arguments) {
    return {text, expected, formatMessage(text, arguments...)};
}

TEST(MessageFormat, ArgumentsStandAtTheirMarkers) {
    const wchar_t* const none = nullptr;
    const FormatCase cases[] = {
        format(L"%2 of %1", L"b of a", L"a", L"b"),
        format(L"%2!d! of %1: %3!g!", L"7 of a: 0.5", L"a", 7, 0.5),
        format(L"%1%2%3%4%5%6%7%8%9%10", L"abcdefghij", L"a", L"b", L"c", L"d", L"e", L"f", L"g", L"h", L"i",
               L"j"),
        format(L"%123", L"MALFORMED FORMATTING STRING: %123"),  // number 12, then text
        format(L"%1!d! items", L"7 items", 7),
        format(L"%1!5d!|", L"   42|", 42),
        format(L"%1!-5d!|", L"42   |", 42),
        format(L"%1!+.3i!", L"+042", 42),
        format(L"%1!u! %2!#x! %3!X! %4!o!", L"4294967295 0xff AB 17", -1, 255, 0xAB, 15),
        format(L"%1!hd! %2!hu! %3!ld!", L"-1 65535 70000", 65535, -1, 70000),
        format(L"\"%1!c!\" %2!C!", L"\"x\" \u00e4", L'x', L'\u00e4'),
        format(L"%1!.2f! %2!e! %3!G!", L"0.12 1.500000e+00 1E-10", 0.125, 1.5, 1e-10),
        format(L"%1!f!", L"-inf", -std::numeric_limits<double>::infinity()),
        format(L"%1!-20.2s!|", L"text|", L"text"),  // flags and widths are not for texts
        format(L"%1!s!%2", L"", none, none),
    };
    for (const FormatCase& c : cases) EXPECT_EQ(c.result, c.expected) << testing::PrintToString(c.text);
}

TEST(MessageFormat, EscapesStandForTheirCharacterBesideMarkersOnly) {
    const FormatCase cases[] = {
        format(L"", L""),
        format(L"100%% sure", L"100%% sure"),
        format(L"%! %. % ", L"%! %. % "),
        format(L"%1 is 100%% sure%!%.% ", L"it is 100% sure!. ", L"it"),
        format(L"%1%!d!", L"7!d!", L"7"),
        format(L"%%1 %1", L"%1 a", L"a"),
        format(L"%1!", L"a!", L"a"),  // no closing mark: text
        format(L"%1!d", L"a!d", L"a"),
    };
    for (const FormatCase& c : cases) EXPECT_EQ(c.result, c.expected) << testing::PrintToString(c.text);
}

TEST(MessageFormat, MalformedTextsStandUnformatted) {
    const wchar_t* const texts[] = {
        L"%",
        L"50 %",
        L"%0",
        L"%00",
        L"%x",
        L"%-1",  // what follows a percent sign
        L"%1 and %3",
        L"%2",
        L"%1 %1",
        L"%1 %1 %3",
        L"%1 %99",
        L"%1 %2 %3 %3",  // gaps and repeats
        L"%1!!",
        L"%1!*d!",
        L"%1!.*d!",
        L"%1!5!",
        L"%1!dd!",
        L"%1! d !",
        L"%1! and %2!",
        L"%1!n!",
        L"%1!p!",
        L"%1!S!",
        L"%1!F!",
        L"%1!a!",
        L"%1!ws!",  // letters
        L"%1!Ld!",
        L"%1!lld!",
        L"%1!hhd!",
        L"%1!Lf!",
        L"%1!lf!",
        L"%1!he!",
        L"%1!ls!",
        L"%1!hs!",
        L"%1!4097d!",
        L"%1!.4097f!",
        L"%1!99999999999999999999d!",
    };
    for (const wchar_t* text : texts)
        EXPECT_EQ(formatMessage(text), std::wstring(L"MALFORMED FORMATTING STRING: ") + text);
}

TEST(MessageFormat, LongArgumentsAreNotCut) {
    const std::wstring text(100000, L'x');
    EXPECT_EQ(formatMessage(L"%1%2", text.c_str(), text.c_str()), text + text);
    EXPECT_EQ(formatMessage(L"%1!4096d!", 1).size(), 4096u);
    EXPECT_EQ(formatMessage(L"%1!.4096f!", std::numeric_limits<double>::max()).size(), 309u + 1 + 4096);
}

}  // namespace
