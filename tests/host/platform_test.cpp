#include <gmock/gmock.h>
#include <sys/resource.h>
#include <sys/stat.h>

#include <cstdlib>
#include <optional>

#include "host/platform/file.h"
#include "host/platform/path.h"
#include "host/sdk/util.h"
#include "support/tempFolder.h"

namespace Ov {
namespace {

using std::string_literals::operator""s;

/// The wide text of these characters, surrogates and others.
std::wstring wide(std::initializer_list<char32_t> characters) {
    std::wstring text;
    for (const char32_t c : characters) text += static_cast<wchar_t>(c);
    return text;
}

TEST(Utf8, BytesThatAreNoCharacterStandForThemselves) {
    const struct {
        const char* name;
        std::string bytes;
        std::wstring text;
    } cases[] = {
        {"ASCII and NUL", "a\0b"s, wide({'a', 0, 'b'})},
        {"two, three and four bytes", "\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80", wide({0xE9, 0x20AC, 0x1F600})},
        {"Latin-1", "\xE9t\xE9", wide({0xDCE9, 't', 0xDCE9})},
        {"overlong slash", "\xC0\xAF", wide({0xDCC0, 0xDCAF})},
        {"overlong in three bytes", "\xE0\x9F\xBF", wide({0xDCE0, 0xDC9F, 0xDCBF})},
        {"overlong in four bytes", "\xF0\x8F\xBF\xBF", wide({0xDCF0, 0xDC8F, 0xDCBF, 0xDCBF})},
        {"surrogate", "\xED\xA0\x80", wide({0xDCED, 0xDCA0, 0xDC80})},
        {"above the last character", "\xF4\x90\x80\x80", wide({0xDCF4, 0xDC90, 0xDC80, 0xDC80})},
        {"last character", "\xF4\x8F\xBF\xBF", wide({0x10FFFF})},
        {"cut off by the end", "x\xE2\x82", wide({'x', 0xDCE2, 0xDC82})},
        {"cut off by a character", "\xE2\x82g", wide({0xDCE2, 0xDC82, 'g'})},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        EXPECT_EQ(fromUtf8(c.bytes), c.text);
        EXPECT_EQ(toUtf8(c.text), c.bytes);
    }
}

TEST(Utf8, EveryCharacterComesBack) {
    for (char32_t block = 0; block <= 0x10FFFF; block += 0x800) {
        if (block == 0xD800) continue;
        std::wstring text;
        for (char32_t c = block; c < block + 0x800; ++c) text += static_cast<wchar_t>(c);
        ASSERT_EQ(fromUtf8(toUtf8(text)), text) << std::hex << static_cast<unsigned>(block);
    }
}

TEST(Utf8, AnyBytesComeBack) {
    // All that differs in any rule: leads and trails at their limits, in every order.
    const std::string edges = "\x00\x41\x7F\x80\x8F\x90\x9F\xA0\xBF\xC0\xC2\xDF\xE0\xE1\xED\xEF\xF0\xF4\xF5\xFF"s;
    for (char a : edges) {
        for (char b : edges) {
            for (char c : edges) {
                for (char d : edges) {
                    const std::string bytes{a, b, c, d};
                    ASSERT_EQ(toUtf8(fromUtf8(bytes)), bytes) << testing::PrintToString(bytes);
                }
            }
        }
    }
}

TEST(Utf8, WideTextIsMadeUnicode) {
    EXPECT_EQ(toUtf8(wide({0xD83D, 0xDE00})), "\xF0\x9F\x98\x80") << "a pair";
    EXPECT_EQ(toUtf8(wide({0xD83D, 'x'})), "\xEF\xBF\xBDx") << "half a pair";
    EXPECT_EQ(toUtf8(wide({0xDC41, 0xDFFF})), "\xEF\xBF\xBD\xEF\xBF\xBD") << "second halves, and no bytes";
    EXPECT_EQ(toUtf8(wide({0x110000})), "\xEF\xBF\xBD");
}

TEST(Path, StemAndFolder) {
    const struct {
        const wchar_t *path, *stem, *folder;
    } cases[] = {
        {L"/lamps/wall.v2.ies", L"wall.v2", L"/lamps"},
        {L"wall.ies", L"wall", L"."},
        {L"a.b/wall", L"wall", L"a.b"},
        {L"/wall", L"wall", L"/"},
        {L"../.ies", L".ies", L".."},
        {L"l\xE4mp\xDCE9.ies", L"l\xE4mp\xDCE9", L"."},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(pathStem(c.path), c.stem);
        EXPECT_EQ(pathFolder(c.path), c.folder);
    }
}

std::optional<std::string> contents(const std::wstring& path) {
    const RnRef<RnBufferedIO> device = openInputFile(path.c_str());
    if (!device) return std::nullopt;
    std::string bytes;
    for (int c = device->getChar(); c >= 0; c = device->getChar()) bytes += static_cast<char>(c);
    return bytes;
}

TEST(InputFile, BytesAreReadAsTheyAre) {
    const TempFolder folder;
    const std::string bytes = "a\r\n\x1A\x00\xFF\n"s;
    folder.write("l\xC3\xA4mp \xE9.ies", bytes);  // a name that is only partly UTF-8
    EXPECT_EQ(contents(folder.wide() + L"/l\xE4mp \xDCE9.ies"), bytes);
    std::filesystem::create_symlink(folder.path() / "l\xC3\xA4mp \xE9.ies", folder.path() / "link");
    EXPECT_EQ(contents(folder.wide("link")), bytes);
}

TEST(InputFile, OnlyRegularFilesOpen) {
    const TempFolder folder;
    ASSERT_EQ(mkfifo((folder.path() / "pipe").c_str(), 0600), 0);  // opening it would wait for a writer
    std::filesystem::create_symlink(folder.path() / "pipe", folder.path() / "link");
    const struct {
        std::wstring path;
        const char* reason;
    } cases[] = {
        {folder.wide(), "it is a folder"},
        {folder.wide("pipe"), "it is not a regular file"},
        {folder.wide("link"), "it is not a regular file"},
        {L"/dev/null", "it is not a regular file"},
        {folder.wide("absent"), "no such file"},
        {folder.wide(std::string(5000, 'x')), "File name too long"},
        {L"", "no such file"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(contents(c.path), std::nullopt);
        EXPECT_EQ(openFailure(c.path.c_str()), toUtf8(c.path) + ": " + c.reason);
    }
    EXPECT_FALSE(openInputFile(nullptr));
}

TEST(InputFile, ItIsClosedWithTheDevice) {
    const TempFolder folder;
    const std::wstring path = folder.write("a", "x");
    rlimit before{};
    getrlimit(RLIMIT_NOFILE, &before);
    const rlimit few{32, before.rlim_max};
    setrlimit(RLIMIT_NOFILE, &few);

    for (int i = 0; i < 100; ++i) EXPECT_EQ(contents(path), "x");
    std::vector<RnRef<RnBufferedIO>> open;
    while (const auto device = openInputFile(path.c_str())) open.push_back(device);
    const std::string failure = openFailure(path.c_str());
    open.clear();
    EXPECT_EQ(contents(path), "x");

    setrlimit(RLIMIT_NOFILE, &before);
    EXPECT_EQ(failure, toUtf8(path) + ": Too many open files");
}

class Language : public testing::Test {
protected:
    ~Language() override {
        set("", "", "");
        WendSDK::Util::setLanguage(L"");
    }
    static void set(const char* all, const char* messages, const char* lang) {
        setenv("LC_ALL", all, 1);
        setenv("LC_MESSAGES", messages, 1);
        setenv("LANG", lang, 1);
    }
};

TEST_F(Language, IsTakenFromTheFirstVariableThatIsNotEmpty) {
    const struct {
        const char *all, *messages, *lang;
        const wchar_t* language;
    } cases[] = {
        {"", "", "de_DE.UTF-8@euro", L"de"},
        {"", "fr", "de", L"fr"},
        {"C", "fr", "de", L""},
        {"it@x", "fr", "de", L"it"},
        {"", "", "POSIX", L""},
        {"", "", "C.UTF-8", L""},
        {"", "", "DE.utf8", L"de"},
        {"", "", "../de", L""},
        {"", "", "de/x_DE", L""},
        {"", "", "d\xC3\xA9", L""},
        {"", "", "_DE", L""},
        {"", "", "de:en", L""},
        {"", "", "", L""},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(testing::Message() << c.all << "|" << c.messages << "|" << c.lang);
        WendSDK::Util::setLanguage(L"xx");
        set(c.all, c.messages, c.lang);
        WendSDK::Util::UseLanguagePackLocale(nullptr);
        EXPECT_EQ(WendSDK::Util::language(), c.language);
    }
}

TEST_F(Language, SetDirectlyHoldsLettersOnly) {
    WendSDK::Util::setLanguage(L"De");
    EXPECT_EQ(WendSDK::Util::language(), L"de");
    WendSDK::Util::setLanguage(L"../..");
    EXPECT_EQ(WendSDK::Util::language(), L"");
}

}  // namespace
}  // namespace Ov
