#include "components/photo/distributions/isotropic.h"
#include "tests/photo/photoFixture.h"

// What the reader accepts and refuses, and with which messages; from a file's angles to a web; what a save writes.

namespace OvPhotometrics {
namespace {

using Ies = FormatTest<IesFormat>;

std::string numbers(const std::string& text) { return "TILT=NONE\n" + text; }
std::string tilted(const std::string& block) { return IesText{.tilt = "INCLUDE\n" + block + "\n"}.text(); }
std::string graded(const std::string& values) { return IesText{.values = values}.text(); }

TEST_F(Ies, EachFaultHasItsMessage) {
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

TEST_F(Ies, AcceptsWhatMakersWrite) {
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

TEST_F(Ies, HeaderLinesAreKeptInPieces) {
    ASSERT_TRUE(read(IesText{.header = "IESNA91\n\n" + std::string(200, 'x') + "\n"}.text()));
    const IesLines expected = {L"IESNA91", L"", std::wstring(80, L'x'), std::wstring(80, L'x'),
                               std::wstring(40, L'x')};
    EXPECT_EQ(rec.lines, expected);
}

TEST_F(Ies, TiltFilesAreFoundAndNamed) {
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

IesText angles(int type, std::vector<double> vertical, std::vector<double> horizontal) {
    return {.type = type, .vertical = std::move(vertical), .horizontal = std::move(horizontal)};
}

TEST_F(Ies, AnglesChooseTheLayout) {
    using enum PhotoWebSymmetry;
    const struct {
        const char* name;
        IesText file;
        PhotoWebSymmetry symmetry;
        int psis;
        double lastPsi, firstTheta;  // degrees
        bool truncated, turned;
    } cases[] = {
        {"one plane", {.horizontal = {0}}, Axial, 1, 0, 0, false, false},
        {"planes 0 and 360", {.horizontal = {0, 360}}, Axial, 1, 0, 0, false, false},
        {"quarter", {.horizontal = {0, 45, 90}}, Quarter, 3, 90, 0, false, false},
        {"half", {.horizontal = {0, 90, 180}}, Half, 3, 180, 0, false, false},
        {"closed circle", {.horizontal = {0, 90, 180, 270, 360}}, Full, 4, 270, 0, false, false},
        {"open circle", {.horizontal = {0, 90, 180, 270}}, Full, 4, 270, 0, false, false},
        {"planes 90 to 270", {.horizontal = {90, 180, 270}}, Half, 3, 180, 0, false, true},
        {"within the tolerance", angles(1, {90.2, 179.8}, {0.2, 89.8}), Quarter, 2, 89.8, 90.2, false, false},
        {"at the tolerance", angles(1, {0, 89.75}, {0, 89.75}), Quarter, 2, 89.75, 0, false, false},
        {"closed at the tolerance", {.horizontal = {0, 90, 180, 270, 360.25}}, Full, 4, 270, 0, false, false},
        {"type A, at the tolerance", angles(3, {-90, 90}, {-90.25, 0, 90}), Full, 3, 180.25, 0, true, true},
        {"type B, one side", angles(2, {-90, 0, 90}, {0, 45, 90}), Half, 3, 90, 0, true, false},
        {"type B, both sides", angles(2, {-90, 0, 90}, {-90, 0, 90}), Full, 3, 180, 0, true, true},
        {"type A, 0 to 180", angles(3, {0, 90, 180}, {-60, 0, 60}), Full, 3, 120, 0, true, true},
        {"type A, part", angles(3, {-40, 50}, {-30, 10}), Full, 2, 40, 50, true, true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        const auto web = import(c.file.text());
        ASSERT_TRUE(web) << log.take();
        EXPECT_EQ(web->getSymmetry(), c.symmetry);
        EXPECT_EQ(web->getPsiCount(), c.psis);
        EXPECT_FLOAT_EQ(web->getPsiRange().last, toRadians(c.lastPsi));
        EXPECT_FLOAT_EQ(web->getThetaRange().first, toRadians(c.firstTheta));
        EXPECT_EQ(web->isPsiTruncated(), c.truncated);
        EXPECT_EQ(web->hasIdentityOrientation(), !c.turned);
    }
}

TEST_F(Ies, LateralFilesAreLitWhereTheirAnglesSay) {
    IesText typeA = angles(3, {-90, 0, 90}, {-60, 0, 60}), typeB = angles(2, {-90, 0, 90}, {-80, 0, 80});
    typeA.values = "0 2 0 0 5 0 0 3 0";
    typeB.values = "0 1 0 0 9 0 0 1 0";  // its axis lies at -Y
    const auto a = distributionOf(*import(typeA.text())), b = distributionOf(*import(typeB.text()));
    EXPECT_NEAR(b->intensityAtUnit({0, -1, 0}), 9, 1e-4);
    for (const auto& [psi, candela] : {std::pair(0.0, 5), {-59.999, 2}, {59.999, 3}, {-61, 0}, {61, 0}, {180, 0}})
        EXPECT_NEAR(a->intensityAtUnit(direction(90, psi)), candela, 1e-4) << psi;
}

TEST_F(Ies, FactorsMultiplyAndZeroIsDark) {
    const std::string tail = " 0 90 0 10 20";
    const auto factors = import("TILT=NONE\n2 500 3 2 1 1 2 0 0 0 0.5 2 60" + tail);
    ASSERT_TRUE(factors);
    EXPECT_EQ(factors->getMaxCandela(), 60);
    EXPECT_EQ(factors->getLumens(), 1000);
    const auto dark = import("TILT=NONE\n2 500 3 2 1 1 2 0 0 0 1 0 60" + tail);
    ASSERT_TRUE(dark);
    EXPECT_EQ(dark->getMaxCandela(), 0);
    EXPECT_EQ(dark->getLumens(), 0);
    EXPECT_EQ(dark->getIntensity(0.5f, 0), 0);
}

const char* const head = "IESNA91\n[TEST]     Test unknown\n[MANUFAC]  Manufacturing company unknown\nTILT=NONE\n";

TEST_F(Ies, CopiesAGridWithRelativeValues) {
    const auto web =
        import(IesText{.vertical = {0, 45, 90}, .horizontal = {0, 180}, .values = "8 4 1 8 0.1 -1"}.text());
    EXPECT_EQ(saved(*web), std::string(head) +
                               "1 1000.00 1\n3 2\n1\n2\n0 0 0\n1 1 0\n 0.00 45.00 90.00\n 0.00 180.00\n"
                               " 1.00 0.50 0.12\n 1.00 0.01 -0.12\n");
}

TEST_F(Ies, CentresALateralGrid) {
    const std::string text =
        saved(*import(IesText{.type = 3, .vertical = {-30, 0, 30}, .horizontal = {-70, -10, 50}}.text()));
    EXPECT_NE(text.find("\n3\n2\n0 0 0\n1 1 0\n 60.00 90.00 120.00\n -60.00 0.00 60.00\n"), std::string::npos)
        << text;
    const auto oneSide = import(IesText{.type = 2, .vertical = {-30, 0, 30}, .horizontal = {0, 90}}.text());
    EXPECT_NE(saved(*oneSide).find("3 2\n3\n"), std::string::npos);
}

TEST_F(Ies, SamplesWhatDoesNotFit) {
    const auto lamp = Ov::rnCreate<Isotropic>();
    lamp->setFlux(1000);
    ASSERT_TRUE(iesRecordFromDistribution(*lamp, rec));
    EXPECT_EQ(rec.grid.verticalCount, 19);
    EXPECT_EQ(rec.grid.horizontalCount, 1);
    EXPECT_EQ(rec.lumensPerLamp, lamp->getFlux());
    for (const float candela : rec.grid.candelas) EXPECT_EQ(candela, lamp->candela);
    const auto web = import(written(rec));
    ASSERT_TRUE(web) << log.take();
    EXPECT_EQ(web->getSymmetry(), PhotoWebSymmetry::Axial);
}

TEST_F(Ies, ASavedGridSavesTheSameAgain) {
    for (const IesText& file :
         {IesText{.vertical = {0, 22.125, 90}, .horizontal = {0, 30.5, 90}}, IesText{.horizontal = {90, 180, 270}},
          IesText{.lumens = -1, .horizontal = {0, 90, 180, 270, 360}}}) {
        const std::string first = saved(*import(file.text()));
        const auto again = import(first);
        ASSERT_TRUE(again) << log.take();
        EXPECT_EQ(saved(*again), first);
    }
}

TEST_F(Ies, BreaksListsBeforeTheirLimit) {
    ASSERT_TRUE(candelaGridAlloc(rec.grid, 100, 3));
    const std::string text = written(rec);
    EXPECT_EQ(longestLine(text), 132u);
    const std::string lists = text.substr(text.find("\n 0.00"));
    EXPECT_EQ(std::count(lists.begin(), lists.end(), ' '), 100 + 3 + 300);
}

TEST_F(Ies, TiltAndEmptyRecords) {
    rec.tiltKind = IesTiltKind::include;
    rec.tilt = {2, {0, 90}, {1, 0.5f}};
    EXPECT_EQ(written(rec),
              "TILT=INCLUDE\n 2\n 2\n 0.00 90.00\n 1.00 0.50\n1 -1.00 1\n2 1\n1\n2\n0 0 0\n1 1 0\n0.0 "
              "180.0\n0.0\n0.0 0.0\n");
    rec.tiltKind = IesTiltKind::file;
    rec.tiltFile = L"a.tlt";
    EXPECT_TRUE(written(rec).starts_with("TILT=" + std::string(70, ' ') + "a.tlt\n"));
    const auto empty = immortal<IESBuilder>().create();
    EXPECT_NE(saved(*empty).find("2 1\n"), std::string::npos);
}

}  // namespace
}  // namespace OvPhotometrics
