#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <map>
#include <regex>
#include <set>
#include <string>

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"
#include "components/support/path.h"
#include "host/sdk/util.h"
#include "support/paths.h"

// The texts of every language against the numbers and arguments of messageIds.h.

namespace messages = OvPhotometrics::messages;
using Ov::MessageEntry;

class MessageTexts : public testing::TestWithParam<const wchar_t*> {
protected:
    MessageTexts() {
        WendSDK::Util::setLanguage(GetParam());
        catalogue.setFileName(Ov::fromUtf8(binFolder() + "/libOVphotoRes.dll").c_str());
        catalogue.getText(0);  // opens it
        WendSDK::Util::setLanguage(L"");
    }

    std::set<std::wstring> textsBetween(unsigned first, unsigned last) {
        std::set<std::wstring> texts;
        for (unsigned id = first; id <= last; ++id) texts.insert(catalogue.getText(id));
        return texts;
    }

    Ov::RnMessageFile catalogue;
};

INSTANTIATE_TEST_SUITE_P(Languages, MessageTexts, testing::Values(L"", L"de"),
                         [](const auto& language) { return *language.param ? "german" : "english"; });

/// The argument letters that a text's markers ask for, in the order of their numbers: "dss".
std::string argumentsOf(const std::wstring& text) {
    static const std::wregex marker(L"%%|%([0-9]+)(!([^!]*)!)?");
    std::map<int, char> letters;
    for (std::wsregex_iterator it(text.begin(), text.end(), marker), end; it != end; ++it) {
        if (!(*it)[1].matched) continue;
        const std::wstring conversion = (*it)[2].matched ? (*it)[3].str() : L"s";
        const wchar_t letter = conversion.empty() ? L'?' : conversion.back();
        letters[std::stoi((*it)[1])] = letter == L'g' ? 'f' : static_cast<char>(letter);
    }
    std::string result;
    for (const auto& [number, letter] : letters) result += letter;
    return result;
}

/// Formats a message with one argument for each letter of `types`; each is added to `shown` as it should appear.
template <class... Arguments>
std::wstring formatAs(const MessageEntry& message, const char* types, Ov::RnMessageFile& catalogue,
                      std::set<std::wstring>& shown, Arguments... arguments) {
    if constexpr (sizeof...(Arguments) < 3) {
        const int number = static_cast<int>(1234 + sizeof...(Arguments));
        const auto next = [&](auto argument, std::wstring text) {
            shown.insert(std::move(text));
            return formatAs(message, types + 1, catalogue, shown, arguments..., argument);
        };
        if (*types == 'd') return next(number, std::to_wstring(number));
        if (*types == 'f') return next(number + 0.5, std::to_wstring(number) + L".5");
        if (*types == 'c') return next(L'\u03b8', L"\u03b8");
        if (*types == 's') return next(L"<text %1>", L"<text %1>");
    }
    EXPECT_EQ(*types, '\0') << message.id;
    return catalogue.format(message.id, arguments...);
}

/// Whether a message can be reported with these arguments.
template <auto message, class... Given>
constexpr bool takes = requires(const OvPhotometrics::Report& report, Given... given) {
    report.post(message, given...);
    report.text(message, given...);
};
static_assert(takes<messages::tbtTripleRange, float, double, float> && takes<messages::webRefused>);
static_assert(takes<messages::tbtSyntaxError, int, std::wstring, const wchar_t*>);
static_assert(takes<messages::integerExpected, wchar_t> && takes<messages::lampCount, std::int32_t>);
static_assert(!takes<messages::webRefused, int> && !takes<messages::tbtTripleRange, float, float>);
static_assert(!takes<messages::lampCount> && !takes<messages::lampCount, int, int>);
static_assert(!takes<messages::lampCount, double> && !takes<messages::lampCount, unsigned>);
static_assert(!takes<messages::lampCount, const wchar_t*> && !takes<messages::lampCount, std::int64_t>);
static_assert(!takes<messages::tbtFlux, std::wstring> && !takes<messages::tbtFlux, int>);
static_assert(!takes<messages::fileNotRead, int> && !takes<messages::fileNotRead, std::string>);
static_assert(!takes<messages::daylightLine, int, std::wstring>);  // in the other order

// A module of its own has a list of its own.
#define OTHER_MESSAGES(message) message(lineTooLong, 13100, int, std::wstring) message(endMissing, 13101)
namespace otherMessages {
OVPHOTO_DEFINE_MESSAGES(OTHER_MESSAGES)
}
static_assert(takes<otherMessages::lineTooLong, int, std::wstring> && !takes<otherMessages::endMissing, int>);
static_assert(otherMessages::all[0].id == 13100 && otherMessages::all[0].arguments == std::string_view("ds"));
static_assert(otherMessages::all[1].id == 13101 && otherMessages::all[1].arguments == std::string_view());

TEST_P(MessageTexts, EveryNumberHasATextThatShowsItsArguments) {
    for (const MessageEntry& message : messages::all) {
        SCOPED_TRACE(message.id);
        const std::wstring text = catalogue.getText(message.id);
        ASSERT_FALSE(text.empty());
        ASSERT_EQ(argumentsOf(text), message.arguments);
        std::set<std::wstring> shown;
        const std::wstring formatted = formatAs(message, message.arguments, catalogue, shown);
        EXPECT_FALSE(formatted.starts_with(L"MALFORMED"));
        for (const std::wstring& argument : shown) EXPECT_NE(formatted.find(argument), formatted.npos);
    }
}

TEST_P(MessageTexts, EveryTextHasANumber) {
    std::set<unsigned> numbers;
    for (const MessageEntry& message : messages::all) EXPECT_TRUE(numbers.insert(message.id).second) << message.id;
    for (unsigned id = 1; id <= 0xFFFF; ++id)
        EXPECT_EQ(catalogue.getText(id).empty(), !numbers.contains(id)) << id;
}

TEST_P(MessageTexts, WhatStandsInOtherTextsFits) {
    // Natural light puts its details in as they are, without resolving escapes.
    for (unsigned id = messages::daylightHeader; id <= messages::daylightSkyShadowsAccuracy; ++id)
        EXPECT_EQ(catalogue.getText(id).find(L'%'), std::wstring::npos) << id;
    for (unsigned id = messages::tbtTokenNumber; id <= messages::tbtTokenOther; ++id)
        EXPECT_LE(catalogue.format(id, L"1234567.125").size(), 63u) << id;
}

TEST_P(MessageTexts, NamesTellMonthsAndZonesApart) {
    EXPECT_EQ(textsBetween(messages::monthJanuary, messages::monthDecemberShort).size(), 23u);
    EXPECT_EQ(textsBetween(messages::zoneSolomonIslands, messages::zoneBrasilia).size(), 31u);
    EXPECT_EQ(catalogue.getText(messages::monthMay), catalogue.getText(messages::monthMayShort));
    EXPECT_EQ(catalogue.getText(messages::monthMarch), *GetParam() ? L"M\u00e4rz" : L"March");
}

TEST(MessageNumbers, StandByNameInTheSources) {
    const std::regex number("\\b(12[89]|130)[0-9]{2}\\b"), comment("//.*"), source("(?!messageIds).*\\.(h|cpp)");
    int lines = 0;
    for (const auto& entry : std::filesystem::recursive_directory_iterator(sourceFolder() + "/components")) {
        if (!std::regex_match(entry.path().filename().string(), source)) continue;
        std::ifstream in(entry.path());
        for (std::string line; std::getline(in, line); ++lines)
            EXPECT_FALSE(std::regex_search(std::regex_replace(line, comment, ""), number)) << entry.path() << line;
    }
    EXPECT_GT(lines, 1000);
}
