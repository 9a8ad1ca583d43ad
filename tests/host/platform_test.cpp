#include <gmock/gmock.h>

#include <cmath>
#include <cstdlib>
#include <limits>

#include "components/support/file.h"
#include "components/support/path.h"
#include "host/componentManager/processController.h"
#include "host/sdk/util.h"
#include "support/tempFolder.h"
#include "testObjects.h"

using namespace Ov;
using namespace std::string_literals;

TEST(Utf8, EveryCharacterAndAnyBytesComeBack) {
    EXPECT_EQ(fromUtf8("a\0\xC3\xA9\xE2\x82\xAC\xF0\x9F\x98\x80\xE9t\xE2\x82g\xE2\x82"s),
              L"a\0\xE9\x20AC\U0001F600\xDCE9t\xDCE2\xDC82g\xDCE2\xDC82"s);
    // Too many bytes, a surrogate, and above the last character.
    for (const std::string bytes :
         {"\xC0\xAF", "\xE0\x9F\xBF", "\xF0\x8F\xBF\xBF", "\xED\xA0\x80", "\xF4\x90\x80\x80"}) {
        std::wstring each;
        for (const char c : bytes) each += static_cast<wchar_t>(0xDC00 + static_cast<unsigned char>(c));
        EXPECT_EQ(fromUtf8(bytes), each);
    }
    std::wstring all;
    for (char32_t c = 0; c <= 0x10FFFF; c = c == 0xD7FF ? 0xE000 : c + 1) {
        const bool pair = sizeof(wchar_t) == 2 && c > 0xFFFF;
        if (pair) all += static_cast<wchar_t>(0xD7C0 + (c >> 10));
        all += static_cast<wchar_t>(pair ? 0xDC00 + (c & 0x3FF) : c);
    }
    EXPECT_TRUE(fromUtf8(toUtf8(all)) == all);
    // Leads and trails at the limits of every rule, in every order.
    const std::string edges = "\x00\x41\x7F\x80\x8F\x90\x9F\xA0\xBF\xC0\xC2\xDF\xE0\xE1\xED\xEF\xF0\xF4\xF5\xFF"s;
    for (std::size_t i = 0; i < 160000; ++i) {
        const std::string any{edges[i % 20], edges[i / 20 % 20], edges[i / 400 % 20], edges[i / 8000]};
        ASSERT_EQ(toUtf8(fromUtf8(any)), any) << testing::PrintToString(any);
    }
    // A pair, half a pair, second halves, and no character.
    EXPECT_EQ(toUtf8(L"\xD83D\xDE00\xD83Dx\xDC41\xDFFF"), "\xF0\x9F\x98\x80\uFFFDx\uFFFD\uFFFD");
    if (sizeof(wchar_t) > 2) {
        EXPECT_EQ(toUtf8(std::wstring(1, static_cast<wchar_t>(0x110000))), "\uFFFD");
    }
}

// Whether a name may hold bytes that are no UTF-8, and a backslash.
constexpr bool namesAreBytes = std::is_same_v<std::filesystem::path::value_type, char>;

class Files : public testing::Test {
protected:
    ~Files() override { setPathList(L"Lamps", {}); }

    static std::string contents(const std::wstring& path) {
        const RnRef<RnBufferedIO> device = openInputFile(path.c_str());
        return device ? readRest(*device) : openFailure(path.c_str());
    }
    /// What is found, as a path in the folder of the test; "-" when nothing is.
    std::filesystem::path find(const std::wstring& name, const wchar_t* list = L"Lamps",
                               const char* base = "base") const {
        std::wstring result = L"left over";
        const std::wstring basePath = base ? folder.wide(base) : L"";
        rnCast<RnProcessController>(RnGetThreadProcessController())
            ->findFile(result, name.c_str(), base ? basePath.c_str() : nullptr, list);
        return result.empty() ? "-" : nativePath(result).lexically_relative(folder.path());
    }

    TempFolder folder;
};

TEST_F(Files, OnlyRegularOnesOpenAndGiveTheirBytes) {
    const std::string bytes = "a\r\n\x1A\x00\xFF\n"s;
    folder.write("l\xC3\xA4mp \u0394\U0001F4A1.ies", bytes);
    EXPECT_EQ(contents(folder.wide() + L"/l\xE4mp \u0394\U0001F4A1.ies"), bytes);
    if (namesAreBytes) {
        folder.write("l\xC3\xA4mp \xE9.ies", bytes);  // only partly UTF-8
        EXPECT_EQ(contents(folder.wide() + L"/l\xE4mp \xDCE9.ies"), bytes);
    }
    EXPECT_EQ(contents(folder.wide()), toUtf8(folder.wide()) + ": it is a folder");
    EXPECT_EQ(contents(L""), ": no such file");
    // Opening a pipe would wait for a writer.
    for (const auto& path : irregularFiles(folder.path()))
        EXPECT_EQ(contents(widePath(path)), toUtf8(widePath(path)) + ": it is not a regular file");
    const std::wstring tooLong = folder.wide(std::string(5000, 'x'));
    EXPECT_THAT(contents(tooLong), testing::MatchesRegex(".*xx: .+"));
    EXPECT_FALSE(openInputFile(nullptr));
    EXPECT_EQ(pathFolder(L"l\xE4mp\xDCE9.v2.ies") + pathStem(L"l\xE4mp\xDCE9.v2.ies"), L".l\xE4mp\xDCE9.v2");
}

TEST_F(Files, AreFoundInTheOrderOfPlacesAndSpellings) {
    for (const char* file :
         {"base/a", "one/a", "one/b", "two/b", "two/c", "elsewhere", "base/my lamp.tlt", "base/sub/lamp.tlt",
          "base/sub\\odd.tlt", "base/sub/odd.tlt", "base/\xC3\xA9.tlt", "base/\xC3\xBC/l.tlt"})
        folder.write(file, "x");
    setPathList(L"Lamps", {folder.wide("one"), L"", folder.wide("two")});
    // Places; then a name as it stands before one with the other slash, the character before the two bytes that a
    // reader takes it for, and bytes with the other slash.
    for (const char* row :
         {"a|base/a", "b|one/b", "c|two/c", "d|-", "sub|base/sub", " \t|-", "sub\\lamp.tlt|base/sub/lamp.tlt",
          " \tmy lamp.tlt \t|base/my lamp.tlt", "sub\\odd.tlt|base/sub\\odd.tlt", "\u00E9.tlt|base/\u00E9.tlt",
          "\u00C3\u00A9.tlt|base/\u00E9.tlt", "\u00C3\u00BC\\l.tlt|base/\u00FC/l.tlt", "\u20AC\u00C3\u00A9.tlt|-"})
        EXPECT_EQ(find(fromUtf8(cells(row)[0])), nativePath(fromUtf8(cells(row)[1]))) << row;
    if (namesAreBytes) {
        for (const char* file : {"base/\xE9.tlt", "base/\xE8.tlt"}) folder.write(file, "x");
        EXPECT_EQ(find(L"\u00E9.tlt"), "base/\u00E9.tlt");
        EXPECT_EQ(find(L"\u00E8.tlt"), "base/\xE8.tlt");
    }
    EXPECT_EQ(find(folder.wide("elsewhere")), "elsewhere");
    EXPECT_EQ(find(L"a", L"Lamps", nullptr), "one/a");
    for (const std::wstring& absent : {folder.wide("absent"), std::wstring(5000, L'x')})
        EXPECT_EQ(find(absent), "-");
    for (const wchar_t* list : {static_cast<const wchar_t*>(nullptr), L"Other"}) EXPECT_EQ(find(L"b", list), "-");
}

TEST(FloatUtil, AbsLeavesTheSignOfZeroAlone) {
    for (const float value : {0.0f, 1e-45f, 2.5f, std::numeric_limits<float>::infinity()})
        for (const float either : {value, -value}) EXPECT_EQ(Ov::FloatUtil::abs(either), value);
    EXPECT_TRUE(std::signbit(Ov::FloatUtil::abs(-0.0f)) && std::isnan(Ov::FloatUtil::abs(std::nanf(""))));
}

TEST(ProcessController, ReportsToItsReporterOrStandardError) {
    const auto controller = rnCast<RnProcessController>(RnGetProcessController());
    std::wstring heard;
    // Gone from inside its own call, it is whole to the end of it.
    setMessageReporter([&heard, own = std::vector(1000, L'x')](int level, const wchar_t* text) {
        setMessageReporter(nullptr);
        heard = std::to_wstring(level) + text + own.back();
    });
    controller->report(3, L"c");
    EXPECT_EQ(heard, L"3cx");
    testing::internal::CaptureStderr();
    controller->report(0, L"l\xE4mp\xDCFF");
    controller->report(0, nullptr);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), "l\xC3\xA4mp\xFF\n\n");
}

TEST(Language, IsTakenFromTheFirstVariableThatIsNotEmpty) {
    for (const char* row : {"||de_DE.UTF-8@euro|de", "|fr|de|fr", "C|fr|de|", "it@x|fr|de|it", "||POSIX|",
                            "||C.UTF-8|", "||DE.utf8|de", "||../de|", "||d\u00E9|", "||_DE|", "|||"}) {
        const auto c = cells(row);
        for (std::size_t i = 0; const char* name : {"LC_ALL", "LC_MESSAGES", "LANG"})
            setVariable(name, c[i++].c_str());
        WendSDK::Util::setLanguage(L"xx");
        WendSDK::Util::UseLanguagePackLocale(nullptr);
        EXPECT_EQ(toUtf8(WendSDK::Util::language()), c[3]) << row;
    }
}
