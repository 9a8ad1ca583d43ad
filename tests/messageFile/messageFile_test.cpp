#include "components/messageFile/message.h"

#include <gtest/gtest.h>

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <limits>

#include "host/sdk/util.h"
#include "tests/support/tempFolder.h"

namespace fs = std::filesystem;
using Ov::RnMessageFileEx;

/// Compiled catalogues of one test, in a folder of its own. The language is none, until the test sets one.
class MessageFile : public testing::Test {
protected:
    MessageFile() { WendSDK::Util::setLanguage(L""); }
    ~MessageFile() override { WendSDK::Util::setLanguage(L""); }

    /// Compiles messages ("5 text", one a line) to a file of the folder; its wide path.
    std::wstring compile(const std::string& name, const std::string& messages) {
        const fs::path file = Ov::nativePath(folder.wide(name));
        fs::create_directories(file.parent_path());
        compileCatalogue(file, messages);
        return Ov::widePath(file);
    }
    static std::string bytesOf(const std::wstring& file) {
        std::ifstream in(Ov::nativePath(file), std::ios::binary);
        return {std::istreambuf_iterator<char>(in), {}};
    }
    std::wstring textIn(const std::wstring& file, unsigned id = 5) {
        catalogue.setFileName(file.c_str());
        return catalogue.getText(id);
    }
    bool opens(const std::wstring& file) {
        try {
            textIn(file);
            return true;
        } catch (const RnMessageFileEx::ExNoCatalogue&) {
            return false;
        }
    }

    bool opensBytes(const std::string& bytes) {
        catalogue.setFileName(L"");  // some systems protect an open file
        return opens(folder.write("bytes", bytes));
    }

    TempFolder folder;
    Ov::RnMessageFile catalogue;
};

TEST_F(MessageFile, LookupWithoutNameOrFileSaysSoAndTriesAgain) {
    const std::wstring file = folder.wide() + L"/Me\u00dfwerte.cat";
    for (int i = 0; i < 2; ++i) {
        catalogue.setFileName(i ? nullptr : L"");
        try {
            catalogue.format(5);
            FAIL();
        } catch (const RnMessageFileEx::ExNoFilename& e) {
            EXPECT_EQ(e.getDetailedReason(),
                      "Message filename not set. (components/messageFile/message, line 145)");
        }
        catalogue.setFileName(file.c_str());
        try {
            catalogue.getText(5);
            FAIL();
        } catch (const std::runtime_error& e) {
            EXPECT_EQ(e.what(), Ov::toUtf8(file) + ": Cannot open message catalogue.");
            EXPECT_EQ(dynamic_cast<const RnMessageFileEx::ExNoCatalogue&>(e).getCode(), 160);
        }
    }
    compile("Me\u00dfwerte.cat", "5 five");
    EXPECT_EQ(catalogue.getText(5), L"five");
}

TEST_F(MessageFile, RefusesWhatIsNoCatalogueOrHasLostTexts) {
    std::vector<fs::path> wrong = irregularFiles(folder.path());
    for (const std::wstring& path : {folder.wide(), folder.wide("a.cat") + L"/a.cat",
                                     folder.write("text", "$set 1\n5 five, long enough for a header\n"),
                                     folder.write("zeros", std::string(5000, '\0'))})
        wrong.push_back(Ov::nativePath(path));
    for (const fs::path& path : wrong) EXPECT_FALSE(opens(Ov::widePath(path))) << path;

    // What lies behind the last text of a resource file may be missing.
    const auto refused = [&](const std::string& bytes, const std::wstring& lastText) {
        return !opensBytes(bytes) || catalogue.getText(7) == lastText;
    };
    const std::string small = bytesOf(compile("small.cat", "5 five\n6 six\n7 seven"));
    for (std::size_t length = 0; length < small.size(); length += 1 + small.size() / 1000)
        EXPECT_TRUE(refused(small.substr(0, length), L"seven")) << length;
    EXPECT_TRUE(opensBytes(small));
    // Texts on pages that the file no longer has.
    const std::string large =
        bytesOf(compile("large.cat", "5 " + std::string(1900, 'a') + "\n7 " + std::string(9000, 'b')));
    for (std::size_t length = 0; length < large.size(); length += 512)
        EXPECT_TRUE(refused(large.substr(0, length), std::wstring(9000, L'b'))) << length;
}

TEST_F(MessageFile, DamagedTablesAreRefusedOrHarmless) {
    const std::string whole = bytesOf(compile("a.cat", "5 five\n6 six\n7 seven"));
    for (std::size_t at = 0; at < whole.size(); at += 1 + whole.size() / 1000) {
        for (const int flip : {0x01, 0x80, 0xFF}) {
            std::string damaged = whole;
            damaged[at] = static_cast<char>(damaged[at] ^ flip);
            if (!opensBytes(damaged)) continue;
            for (unsigned id = 0; id < 10; ++id) EXPECT_LT(catalogue.getText(id).size(), whole.size());
        }
    }
}

TEST_F(MessageFile, TextsByNumber) {
    const std::string longText(5000, 'x');
    const std::wstring file = compile("a.cat", "1 one\n5 Lichtst\u00e4rke %1!d!\n6 " + longText + "\n65535 last");
    EXPECT_EQ(textIn(file), L"Lichtst\u00e4rke %1!d!");
    EXPECT_EQ(catalogue.format(5, 7), L"Lichtst\u00e4rke 7");
    EXPECT_EQ(catalogue.getText(6), std::wstring(5000, L'x'));
    EXPECT_EQ(catalogue.getText(65535), L"last");
    for (const unsigned id : {0u, 2u, 65536u, 65537u, 0x80000001u, 0xFFFFFFFFu})
        EXPECT_EQ(catalogue.getText(id) + catalogue.format(id, 7), L"") << id;
}

TEST_F(MessageFile, AnOpenFileStaysUntilItsNameIsSetAgain) {
    const std::wstring file = compile("a.cat", "5 old");
    EXPECT_EQ(textIn(file), L"old");
    compile("a.cat", "5 new, and longer than the old one");
    EXPECT_EQ(catalogue.getText(5), L"old");
    fs::remove(Ov::nativePath(file));
    EXPECT_EQ(catalogue.getText(5), L"old");
    EXPECT_FALSE(opens(file));
}

TEST_F(MessageFile, TheLanguageSetInTheHostComesFirst) {
    const std::wstring file = compile("a.cat", "5 five\n6 six");
    compile("de/a.cat", "5 f\u00fcnf");
    folder.write("fr/a.cat", "no catalogue");
    for (const auto& [language, text] : {std::pair{L"", L"five"}, std::pair{L"it", L"five"},
                                         std::pair{L"fr", L"five"}, std::pair{L"de", L"f\u00fcnf"}}) {
        WendSDK::Util::setLanguage(language);
        EXPECT_EQ(textIn(file), text);
        EXPECT_EQ(catalogue.fileName(), file);
    }
    // A pack stands alone: what it lacks is not looked for elsewhere. It is chosen when the file is opened.
    EXPECT_EQ(catalogue.getText(6), L"");
    WendSDK::Util::setLanguage(L"");
    EXPECT_EQ(catalogue.getText(5), L"f\u00fcnf");
}

TEST_F(MessageFile, ANameWithoutAFolderIsOneOfTheCurrentFolder) {
    for (const char* name : {"elsewhere/a.cat", "elsewhere/b.cat", "a.cat", "de/a.cat"})
        compile(name, std::string("5 ") + name);
    const fs::path before = fs::current_path();
    fs::current_path(folder.path());
    setVariable("NLSPATH", (folder.path() / "elsewhere/%N").string().c_str());
    EXPECT_EQ(textIn(L"a.cat"), L"a.cat");
    EXPECT_FALSE(opens(L"b.cat"));
    WendSDK::Util::setLanguage(L"de");
    EXPECT_EQ(textIn(L"a.cat"), L"de/a.cat");
    setVariable("NLSPATH", "");
    fs::current_path(before);
}

TEST(MessageFormat, ArgumentsStandAtTheirMarkers) {
    const wchar_t* const none = nullptr;
    EXPECT_EQ(Ov::formatMessage(L"%2!d! of %1: %3!g!", L"a", 7, 0.5), L"7 of a: 0.5");
    EXPECT_EQ(
        Ov::formatMessage(L"%1%2%3%4%5%6%7%8%9%10", L"a", L"b", L"c", L"d", L"e", L"f", L"g", L"h", L"i", L"j"),
        L"abcdefghij");
    EXPECT_EQ(Ov::formatMessage(L"%1!5d!|%2!-5d!|%3!+.3i!", 42, 42, 42), L"   42|42   |+042");
    EXPECT_EQ(Ov::formatMessage(L"%1!u! %2!#x! %3!X! %4!o!", -1, 255, 0xAB, 15), L"4294967295 0xff AB 17");
    EXPECT_EQ(Ov::formatMessage(L"%1!hd! %2!hu! %3!ld!", 65535, -1, 70000), L"-1 65535 70000");
    EXPECT_EQ(Ov::formatMessage(L"\"%1!c!\" %2!C!", L'x', L'\u00e4'), L"\"x\" \u00e4");
    EXPECT_EQ(Ov::formatMessage(L"%1!hc!%2!hC!", 0x103b8, -0xfc48), L"\u03b8\u03b8");
    EXPECT_EQ(Ov::formatMessage(L"%1!.2f! %2!e! %3!G!", 0.125, 1.5, 1e-10), L"0.12 1.500000e+00 1E-10");
    EXPECT_EQ(Ov::formatMessage(L"%1!f!", -std::numeric_limits<double>::infinity()), L"-inf");
    EXPECT_EQ(Ov::formatMessage(L"%1!-20.2s!|", L"text"), L"text|");  // flags and widths are not for texts
    EXPECT_EQ(Ov::formatMessage(L"%1!s!%2", none, none), L"");
}

TEST(MessageFormat, EscapesStandForTheirCharacterBesideMarkersOnly) {
    for (const wchar_t* text : {L"", L"100%% sure", L"%! %. % "}) EXPECT_EQ(Ov::formatMessage(text), text);
    EXPECT_EQ(Ov::formatMessage(L"%1 is 100%% sure%!%.% ", L"it"), L"it is 100% sure!. ");
    EXPECT_EQ(Ov::formatMessage(L"%%1 %1%!d!", L"7"), L"%1 7!d!");
    EXPECT_EQ(Ov::formatMessage(L"%1!", L"a"), L"a!");  // no closing mark: text
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
        EXPECT_EQ(Ov::formatMessage(text), std::wstring(L"MALFORMED FORMATTING STRING: ") + text);
}

TEST(MessageFormat, MarkersThatDoNotFitTheirArgumentAreMalformed) {
    for (const wchar_t* text :
         {L"%1 %2!d! %3!g! %4", L"%1!d!", L"%1!g!", L"%1 %2", L"%1 %2!f!", L"%1 %2!d! %3!c!"})
        EXPECT_EQ(Ov::formatMessage(text, L"a", 7, 0.5), std::wstring(L"MALFORMED FORMATTING STRING: ") + text);
    EXPECT_EQ(Ov::formatMessage(L"%1", L"a", 7, 0.5), L"a");  // a text need not show all
}

TEST(MessageFormat, LongArgumentsAreNotCut) {
    const std::wstring text(100000, L'x');
    EXPECT_EQ(Ov::formatMessage(L"%1%2", text.c_str(), text.c_str()), text + text);
    EXPECT_EQ(Ov::formatMessage(L"%1!4096d!", 1).size(), 4096u);
    EXPECT_EQ(Ov::formatMessage(L"%1!.4096f!", std::numeric_limits<double>::max()).size(), 309u + 1 + 4096);
}
