#include "tests/photo/photoFixture.h"

// What the reader accepts and refuses, and with which messages.

namespace OvPhotometrics {
namespace {

using IesRead = FormatTest<IesFormat>;

std::string numbers(const std::string& text) { return "TILT=NONE\n" + text; }
std::string tilted(const std::string& block) { return IesText{.tilt = "INCLUDE\n" + block + "\n"}.text(); }
std::string graded(const std::string& values) { return IesText{.values = values}.text(); }

TEST_F(IesRead, EachFaultHasItsMessage) {
    const Refusal cases[] = {
        {"", "12945 12956", "empty file"},
        {"IESNA91\n[TEST] tilt\n", "12945 12956", "no TILT line"},
        {numbers(""), "12945 12946; 12945 12959 -1", "nothing behind TILT"},
        {numbers("0 1 1 2 1 1 2 0 0 0"), "12945 12959 0", "no lamp"},
        {numbers("+1"), "12945 12947 +; 12945 12959 0", "leading plus"},
        {numbers("1 "), "12945 12946; 12945 12960 -1", "cut off behind the lamps"},
        {numbers("1 1 1 1 1 1 2"), "12945 12960 1", "one vertical angle"},
        {numbers("1 1 1 73.5 1"), "12945 12946; 12945 12960 -1", "fraction as a count"},
        {numbers("1 1 1 2 0 1 2"), "12945 12961 0", "no horizontal angle"},
        {numbers("1 1 1 2 1 4 2"), "12945 12962 4", "type 4"},
        {numbers("1 1 1 2 1 1 0"), "12945 12963 0", "units 0"},
        {numbers("1 x 1 2 1 1 2 0 0 0"), "12945 12948 x; 12945 12964", "bad lumens are told with the dimensions"},
        {numbers("1 1 1 2 1 1 2 0 0"), "12945 12946; 12945 12964", "missing dimension"},
        {numbers("1 1 1 2 1 1 2 0 0 0 1 1e99 60"), "12945 12946; 12945 12965", "factors"},
        {numbers("1 1 1 65536 65536 1 2 0 0 0 1 1 60"), "12945 12936", "grid beyond all counts"},
        {numbers("1 1 1 40000 40000 1 2 0 0 0 1 1 60 0 1"), "12945 12946; 12945 12966", "huge counts, short file"},
        {numbers("1 1 1 2 1 1 2 0 0 0 1 1 60 0 x 90"), "12945 12948 x; 12945 12966", "vertical angle"},
        {numbers("1 1 1 2 1 1 2 0 0 0 1 1 60 0 90 -"), "12945 12946; 12945 12967", "horizontal angle"},
        {graded("1 12.5.3 3"), "12945 12946; 12945 12968", "two points"},
        {graded("1 7x 3"), "12945 12946; 12945 12948 x; 12945 12968", "number with a tail"},
        {graded("1 2"), "12945 12946; 12945 12968", "cut off in the candelas"},
        {IesText{.vertical = {0, 90, 80, 180}}.text(), "12943", "angles fall"},
        {IesText{.horizontal = {0, 90, 45}}.text(), "12944", "planes fall"},
        {IesText{.vertical = {0, 120}}.text(), "12940", "type C vertical"},
        {IesText{.horizontal = {0, 120}}.text(), "12941 120", "type C last"},
        {IesText{.horizontal = {45, 90}}.text(), "12942 45", "type C first"},
        {IesText{.type = 2, .vertical = {-90, 90.5}, .horizontal = {0, 90}}.text(), "12937", "type B vertical"},
        {IesText{.type = 2}.text(), "12938", "type B one plane"},
        {IesText{.type = 2, .vertical = {-90, 90}, .horizontal = {0, 90.5}}.text(), "12939", "type B last"},
        {IesText{.type = 2, .vertical = {-90, 90}, .horizontal = {10, 90}}.text(), "12939", "type B first"},
        {IesText{.type = 3, .vertical = {-90.5, 90}, .horizontal = {0, 90}}.text(), "12932", "type A vertical"},
        {IesText{.type = 3}.text(), "12933", "type A one plane"},
        {IesText{.type = 3, .vertical = {-90, 90}, .horizontal = {-91, 90}}.text(), "12934", "type A first"},
        {IesText{.horizontal = {0, 0.1, 360}}.text(), "12928; 12935", "the web refuses"},
        {numbers("1 1 1e30 2 1 1 2 0 0 0 1 1 60 0 90 0 1e30 1"), "12935", "product overflows"},
        {IesText{.lumens = -1, .values = "3e38 3e38 3e38"}.text(), "12935", "flux overflows"},
        {numbers("3 3e38 1 2 1 1 2 0 0 0 1 1 60 0 90 0 0 0"), "12935", "lumens overflow in the dark"},
        {numbers("1 3e38 1 2 1 1 2 0 0 0 1 1 60 0 90 0 0.01 0"), "12935", "lumens for a candela overflow"},
        {numbers("1 1 1 2147483647 1 1 2 0 0 0 1 1 60 0"), "12945 12946; 12945 12966", "most candela"},
        {numbers("1 1 1 1073741824 2 1 2 0 0 0 1 1 60 0"), "12945 12936", "one more"},
        {tilted("4 2 0 90 1 1"), "12945 12949 4", "tilt geometry"},
        {tilted("1 1"), "12945 12950 1", "tilt pairs"},
        {tilted("1 2 5 90 1 1"), "12945 12951 5", "tilt first angle"},
        {tilted("1 3 0 45 45 1 1 1"), "12945 12952 45 45", "tilt order"},
        {tilted("1 2 0 80 1 1"), "12945 12953 80", "tilt last angle"},
        {tilted("1 2 0 89.85 1 1"), "12945 12953 89.85", "tilt last angle beyond the tolerance"},
        {tilted("1 3 0 x 90 1 1 1"), "12945 12948 x; 12945 12954 3", "tilt angle fails"},
        {"TILT=INCLUDE\n1 2 0 90 1", "12945 12946; 12945 12955 2", "tilt factors cut off"},
        {IesText{.tilt = " lost.tlt\n"}.text(), "12957  lost.tlt", "no tilt file"},
    };
    refuses(IesText{}.text(), cases);
    contentTestIs(true, {"IESNA91", "a\nb\nTILT=NONE", "iesna91\r\nTILT="});
    contentTestIs(false, {"IESNA9", "", "a TILT=", "a\rTILT=NONE\r", "\n\nTILT"});
}

TEST_F(IesRead, AcceptsWhatMakersWrite) {
    const std::string plain = IesText{}.text();
    const std::string expected = saved(*imported(plain));
    std::string commas = plain;
    std::replace(commas.begin() + static_cast<std::ptrdiff_t>(commas.find("TILT=NONE") + 10), commas.end(), ' ',
                 ',');
    const std::pair<const char*, std::string> cases[] = {
        {"CR LF", withLineEnds(plain, "\r\n")},
        {"lone CR", withLineEnds(plain, "\r")},
        {"commas", commas},
        {"Ctrl-Z behind the last number", plain.substr(0, plain.size() - 1) + '\x1a'},
        {"NUL behind the last number", plain.substr(0, plain.size() - 1) + '\0'},
        {"no IESNA91", IesText{.header = "1234\n\n[A] b\n"}.text()},
        {"header bytes above 127", IesText{.header = "IESNA91\n\xe4\xff\n"}.text()},
        {"long lines", IesText{.header = std::string(200, '=') + "\n"}.text()},
        {"tilt in lower case, blanks", IesText{.tilt = "none \t\n"}.text()},
        {"tilt data", tilted("1 2 0 89.95 1 1")},
        {"counts with a fraction of zeros", "TILT=NONE\n1.0 1e3 1 3.00 1. 1 2 0 0 0 1 1 60 0 90 180 0 1 2 3"},
        {"tiny values are 0", graded("1 2 3 1e-50")},
    };
    for (const auto& [name, text] : cases) {
        SCOPED_TRACE(name);
        const auto web = imported(text);
        EXPECT_EQ(log.take(), "");
        ASSERT_TRUE(web);
        EXPECT_EQ(saved(*web), expected);
    }
}

TEST_F(IesRead, HeaderLinesAreKeptInPieces) {
    ASSERT_TRUE(read(IesText{.header = "IESNA91\n\n" + std::string(200, 'x') + "\n"}.text()));
    const IesLines expected = {L"IESNA91", L"", std::wstring(80, L'x'), std::wstring(80, L'x'),
                               std::wstring(40, L'x')};
    EXPECT_EQ(rec.lines, expected);
}

TEST_F(IesRead, TiltFilesAreFoundAndNamed) {
    TempFolder beside, listed;
    beside.write("a.tlt", "1 2 0 90 1 1");
    const std::wstring inList = listed.write("b.tlt", "1\n2\n0 90\n1 1\n");
    beside.write("bad.tlt", "1 2 0 45 1 1");
    beside.write("folder/x", "");
    Ov::setPathList(L"WebPathList", {listed.wide()});
    const auto tiltPath = [&](const char* name) -> std::wstring {
        const auto web = import(IesText{.tilt = std::string(name) + "\n"}.text(), L"", beside.wide().c_str());
        if (!web) return log.take().empty() ? L"silent" : L"refused";
        std::wstring visited, again;
        auto visitor = Ov::rnVisitor<const wchar_t*>([&](const wchar_t* path) { visited += path; });
        auto second = Ov::rnVisitor<const wchar_t*>([&](const wchar_t* path) { again += path; });
        web->enumerateFiles(visitor);
        web->clone()->enumerateFiles(second);
        EXPECT_EQ(visited, again);
        return visited;
    };
    EXPECT_EQ(tiltPath("a.tlt"), beside.wide("a.tlt"));
    EXPECT_EQ(tiltPath("  b.tlt "), inList);
    EXPECT_EQ(tiltPath("NONE"), L"");
    EXPECT_EQ(tiltPath("NONEX"), L"refused");
    EXPECT_EQ(tiltPath("bad.tlt"), L"refused");
    EXPECT_EQ(tiltPath("folder"), L"refused");
    Ov::setPathList(L"WebPathList", {});
}

}  // namespace
}  // namespace OvPhotometrics
