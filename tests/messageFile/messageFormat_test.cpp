#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "components/messageFile/message.h"

using Ov::formatMessage;

TEST(MessageFormat, ArgumentsStandAtTheirMarkers) {
    const wchar_t* const none = nullptr;
    EXPECT_EQ(formatMessage(L"%2!d! of %1: %3!g!", L"a", 7, 0.5), L"7 of a: 0.5");
    EXPECT_EQ(formatMessage(L"%1%2%3%4%5%6%7%8%9%10", L"a", L"b", L"c", L"d", L"e", L"f", L"g", L"h", L"i", L"j"),
              L"abcdefghij");
    EXPECT_EQ(formatMessage(L"%1!5d!|%2!-5d!|%3!+.3i!", 42, 42, 42), L"   42|42   |+042");
    EXPECT_EQ(formatMessage(L"%1!u! %2!#x! %3!X! %4!o!", -1, 255, 0xAB, 15), L"4294967295 0xff AB 17");
    EXPECT_EQ(formatMessage(L"%1!hd! %2!hu! %3!ld!", 65535, -1, 70000), L"-1 65535 70000");
    EXPECT_EQ(formatMessage(L"\"%1!c!\" %2!C!", L'x', L'\u00e4'), L"\"x\" \u00e4");
    EXPECT_EQ(formatMessage(L"%1!hc!%2!hC!", 0x103b8, -0xfc48), L"\u03b8\u03b8");
    EXPECT_EQ(formatMessage(L"%1!.2f! %2!e! %3!G!", 0.125, 1.5, 1e-10), L"0.12 1.500000e+00 1E-10");
    EXPECT_EQ(formatMessage(L"%1!f!", -std::numeric_limits<double>::infinity()), L"-inf");
    EXPECT_EQ(formatMessage(L"%1!-20.2s!|", L"text"), L"text|");  // flags and widths are not for texts
    EXPECT_EQ(formatMessage(L"%1!s!%2", none, none), L"");
}

TEST(MessageFormat, EscapesStandForTheirCharacterBesideMarkersOnly) {
    for (const wchar_t* text : {L"", L"100%% sure", L"%! %. % "}) EXPECT_EQ(formatMessage(text), text);
    EXPECT_EQ(formatMessage(L"%1 is 100%% sure%!%.% ", L"it"), L"it is 100% sure!. ");
    EXPECT_EQ(formatMessage(L"%%1 %1%!d!", L"7"), L"%1 7!d!");
    EXPECT_EQ(formatMessage(L"%1!", L"a"), L"a!");  // no closing mark: text
}

TEST(MessageFormat, MalformedTextsStandUnformatted) {
    // What follows a percent sign; gaps and repeats; letters, modifiers and widths. 123 is number 12, then text.
    for (const wchar_t* text : {L"%",           L"50 %",
                                L"%0",          L"%x",
                                L"%-1",         L"%123",
                                L"%1 and %3",   L"%2",
                                L"%1 %1",       L"%1 %99",
                                L"%1 %2 %3 %3", L"%1!!",
                                L"%1!*d!",      L"%1!.*d!",
                                L"%1!5!",       L"%1!dd!",
                                L"%1! d !",     L"%1! and %2!",
                                L"%1!n!",       L"%1!p!",
                                L"%1!S!",       L"%1!F!",
                                L"%1!a!",       L"%1!Ld!",
                                L"%1!lld!",     L"%1!hhd!",
                                L"%1!Lf!",      L"%1!lf!",
                                L"%1!he!",      L"%1!ls!",
                                L"%1!hs!",      L"%1!4097d!",
                                L"%1!.4097f!",  L"%1!99999999999999999999d!"})
        EXPECT_EQ(formatMessage(text), std::wstring(L"MALFORMED FORMATTING STRING: ") + text);
}

TEST(MessageFormat, MarkersThatDoNotFitTheirArgumentAreMalformed) {
    for (const wchar_t* text :
         {L"%1 %2!d! %3!g! %4", L"%1!d!", L"%1!g!", L"%1 %2", L"%1 %2!f!", L"%1 %2!d! %3!c!"})
        EXPECT_EQ(formatMessage(text, L"a", 7, 0.5), std::wstring(L"MALFORMED FORMATTING STRING: ") + text);
    EXPECT_EQ(formatMessage(L"%1", L"a", 7, 0.5), L"a");  // a text need not show all
}

TEST(MessageFormat, LongArgumentsAreNotCut) {
    const std::wstring text(100000, L'x');
    EXPECT_EQ(formatMessage(L"%1%2", text.c_str(), text.c_str()), text + text);
    EXPECT_EQ(formatMessage(L"%1!4096d!", 1).size(), 4096u);
    EXPECT_EQ(formatMessage(L"%1!.4096f!", std::numeric_limits<double>::max()).size(), 309u + 1 + 4096);
}
