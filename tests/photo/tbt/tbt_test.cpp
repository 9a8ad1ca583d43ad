#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/web.h"
#include "components/photo/tbt/photoWebTBT.h"
#include "tests/photo/photoFixture.h"

// What the reader accepts and refuses, the web that comes of it, and what is written.

namespace OvPhotometrics {
namespace {

/// The text of a TBT file; a test sets what is odd about it and nothing else.
struct TbtText {
    std::string title = "Spot";
    std::string kind = "3";
    std::string triple = "1 0.5 0";
    std::string scalars = "1200 1000 1.2 1 5 0";
    std::string grid = "3 5 2";
    std::string values = "100 80 50 Z0\n100 90 0 0 10";
    std::string end = "-1\n";

    std::string text() const {
        return title + "\n" + kind + "\n" + triple + "\n" + scalars + "\n" + grid + "\n" + values + "\n" + end;
    }
};

std::string values(const std::string& text) { return TbtText{.values = text}.text(); }
std::string kind(const std::string& text) { return TbtText{.kind = text}.text(); }
std::string grid(const std::string& text) { return TbtText{.grid = text}.text(); }

using Tbt = FormatTest<TbtFormat>;

TEST_F(Tbt, EachTokenHasItsMessage) {
    const std::pair<std::string, int> tokens[] = {
        {"5", 13002},   {"0.1", 13005}, {"7", 13004},  {"1", 13009}, {".5", 13009}, {"0", 13009}, {"1200", 13010},
        {"1e3", 13012}, {"1", 13014},   {"1", 13015},  {"5", 13016}, {"0", 13017},  {"3", 13018}, {"2", 13020},
        {"2", 13022},   {"9", 13024},   {"Z0", 13024}, {"1", 13024}, {"2", 13024},  {"-1", 13025}};
    std::string text = "Spot\n";
    int lineFeeds = 1;
    for (const auto& [token, message] : tokens) {
        const std::string start = "12998 " + std::to_string(lineFeeds++) + " " + std::to_string(message);
        const std::pair<const char*, const char*> wrong[] = {
            {"", " 12996"}, {"/1", " 12997 /"}, {"-2", " 12997 -"}, {"Z", " 12997 Z"}, {"\xe9", " 12997 é"}};
        for (const auto& [instead, found] : wrong) {
            EXPECT_FALSE(read(text + instead));
            EXPECT_EQ(log.take(), start + found);
            EXPECT_TRUE(rec.values.empty());
        }
        text += token + "\n";
    }
    EXPECT_TRUE(read(text)) << log.take();
}

TEST_F(Tbt, EachFaultHasItsMessage) {
    const std::string nines(90, '9');
    const Refusal cases[] = {
        {"", "12998 0 13002 12996"},
        {"Spot\n\n/* 3\n/*/\n", "12998 4 13002 12996"},
        {kind("/*\n\n*/ 7.9"), "12999 3 13007 7"},
        {kind("4294967299"), "12999 1 13007 2147483647"},
        {kind(".3"), "12999 1 13007 0"},
        {kind("4 Z0"), "12998 1 13003 12994 Z0"},
        {kind("6 -1"), "12998 1 13006 12995 -1"},
        {TbtText{.triple = "1 0 1.5\r"}.text(), "12999 2 13008 1 0 1.5"},
        {TbtText{.scalars = "0 1e-99 1"}.text(), "12999 3 13013 0"},
        {grid("5"), "12999 4 13019 5"},
        {grid("1 1"), "12999 4 13021 1"},
        {grid("1 2147483648 1"), "12999 4 13021 2147483647"},
        {grid("1 2 2"), "12999 4 13023 2"},
        {grid("3 2 1"), "12999 4 13023 1"},
        {grid("4 1025 1024"), "13000 12936", "more than 2^20 values"},
        {grid("4 2147483647 2147483647"), "13000 12936", "counts beyond memory"},
        {values("1 2 3 4 5\n6 7 8 9"), "12998 7 13024 12995 -1"},
        {values("1 2 3 4 5 Z0 7"), "12998 5 13025 12993 7"},
        {values("1.2.3 4 Z0 5 Z0 z0"), "12998 5 13025 12994 z0"},
        {values("3.5e38 Z0 Z0"), "12935", "a float cannot hold it"},
        {values("Z0 0." + nines), "12998 5 13024 "},
        {values("Z0 Z0 " + nines.substr(33)), "12998 5 13025 12993 " + nines.substr(33),
         "the longest description"},
        {values("Z0 Z0 " + nines.substr(32)), "12998 5 13025 ", "a longer one"},
        {TbtText{.scalars = "0 1 1 1 1 1", .values = "3e38 3e38 3e38 Z0 Z0"}.text(), "12935", "flux overflows"},
        {"t\n3\n1 1 1\n1e-6 1000 1 1 5 0\n1 2 1\n3e38 Z0\n-1", "12935", "the candela for its flux overflows"},
    };
    refuses(TbtText{}.text(), cases);
    contentTestIs(true, {"Spot\n3", "/**/\na b\r6.5 x"});
    contentTestIs(false, {"a\n7", "a\nZ0", "3", "", "a\n4294967299"});
}

TEST_F(Tbt, AcceptsWhatTheGrammarAllows) {
    const std::string expected =
        "Spot\n3\n1.0000 0.5000 0.0000\n1200.00 1000.00 1.200000047683716 1 5 0\n3 5 2\n"
        " 100.00 80.00 50.00 Z0\n 100.00 90.00 0.00 0.00 10.00\n-1\n";
    const std::string texts[] = {
        withLineEnds(TbtText{}.text(), "\r\n"),
        TbtText{.title = " \n\n/* a\n/ ** */ /**/\tSpot\r"}.text(),
        values("1e2 8E+1 50. z0 100/**/90 .0 0 10.0e"),
        values("1000e-1 80.0000001 50Z0100 90 . 1e-60 10e+"),
        TbtText{.kind = "3.9 ", .grid = "3e9 5.5 2/*rows*/", .end = "-1 what follows is not read"}.text(),
    };
    for (const std::string& text : texts) {
        EXPECT_TRUE(read(text)) << text << log.take();
        EXPECT_EQ(written(rec), expected);
    }
    EXPECT_TRUE(read(TbtText{.title = "/ " + std::string(98, 'x') + "3 3"}.text()));
    EXPECT_EQ(rec.title, L"/ " + std::wstring(78, L'x'));
}

TEST_F(Tbt, RowsAreWrittenInShortAndReadBack) {
    const std::pair<std::vector<float>, std::string> cases[] = {
        {{10, 0, 0, 0}, " 10.00 Z0\n"},
        {{10, 0}, " 10.00 0.\n"},
        {{0, 0, 0}, " 0.00 Z0\n"},
        // A line of 68 characters takes a further value, one of 70 does not.
        {{1000, 10, 10, 10, 10, 10, 10, 10, 10, 10, 10, 9},
         " 1000.00 10.00 10.00 10.00 10.00 10.00 10.00 10.00 10.00 10.00 10.00 9.00\n"},
        {std::vector<float>(8, 123456.75f),
         " 123456.75 123456.75 123456.75 123456.75 123456.75 123456.75 123456.75\n 123456.75\n"},
    };
    for (const auto& [row, lines] : cases) {
        rec = TbtFileRecord{.title = L"Spot", .symmetryCode = 1, .horizontalCount = 1, .values = row};
        rec.verticalCount = static_cast<std::int32_t>(row.size());
        const std::string text = written(rec);
        EXPECT_TRUE(text.ends_with("\n1 " + std::to_string(row.size()) + " 1\n" + lines + "-1\n")) << text;
        EXPECT_TRUE(read(text)) << log.take();
        EXPECT_EQ(rec.values, row);
    }
}

TEST_F(Tbt, SymmetryCodesAreWebsOfEvenAngles) {
    using enum PhotoWebSymmetry;
    const struct {
        const char* grid;
        const char* values;
        PhotoWebSymmetry symmetry;
        double lastPsi;  // degrees
    } cases[] = {{"1 3 1", "4 2 1", Axial, 0},
                 {"2 3 2", "4 2 1 4 1 0", Quarter, 90},
                 {"3 3 3", "4 2 1 4 1 0 4 Z0", Half, 180},
                 {"4 3 3", "4 2 1 4 1 0 4 2 1", Full, 360}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.grid);
        const auto web = imported(TbtText{.grid = c.grid, .values = c.values}.text());
        ASSERT_TRUE(web) << log.take();
        EXPECT_EQ(web->getSymmetry(), c.symmetry);
        EXPECT_FLOAT_EQ(web->getPsiRange().last, toRadians(c.lastPsi));
        EXPECT_EQ(web->getTheta(1), halfPi);
        EXPECT_EQ(web->getCandela(0, 1), 0.5f);
        EXPECT_EQ(web->getMaxCandela(), 4);
        EXPECT_EQ(web->getLumens(), 1200);
        const std::string again = saved(*web);
        EXPECT_TRUE(again.starts_with("QRT photometric web\n3\n1.0000 1.0000 1.0000\n1200.00 1000.00 1.2000"));
        EXPECT_EQ(imported(again)->getLumens(), 1200);
    }
}

TEST_F(Tbt, SavesSampleTheWebOnItsOwnSteps) {
    const std::pair<IesText, const char*> cases[] = {
        {{.vertical = {0, 5, 90, 180}, .horizontal = {0, 30, 90}}, "\n2 37 4\n"},
        {{.vertical = {0, 2.6, 90}}, "\n1 70 1\n"},
        {{.vertical = {0, 1, 90}, .horizontal = {0, 1, 180}}, "\n3 90 180\n"},
        {{.vertical = {0, 0, 90}, .horizontal = {0, 0, 90}}, "\n2 90 180\n"},
        {{.horizontal = {0, 90, 180, 270, 360}}, "\n4 3 5\n"},
    };
    for (const auto& [file, sizes] : cases) {
        ASSERT_TRUE(tbtRecordFromDistribution(*distributionOf(*import(file.text())), rec));
        EXPECT_NE(written(rec).find(sizes), std::string::npos) << written(rec).substr(0, 100);
    }
    for (const float flux : {3000.0f, 0.0f}) {
        const auto lamp = Ov::rnCreate<Isotropic>();
        lamp->setFlux(flux);
        ASSERT_TRUE(tbtRecordFromDistribution(*lamp, rec));
        EXPECT_EQ(rec.values, std::vector<float>(90, flux > 0 ? lamp->candela * (1 / 3.0f) : 0));
    }
    EXPECT_THROW(tbtRecordFromDistribution(*Ov::rnCreate<Web>(), rec), Ov::ExBadCast);
}

TEST_F(Tbt, FactsAreCarriedWhereTheReaderAcceptsThem) {
    ASSERT_TRUE(read(TbtText{.kind = "5 0.25 7", .scalars = "9 8 7 6 5 0.1"}.text()));
    FileFacts own;
    tbtDescribe(rec, own);
    rec = TbtFileRecord();
    tbtCarry(own, L"name", rec);
    EXPECT_EQ(written(rec),
              "Spot\n5\n0.25 7  1.0000 0.5000 0.0000\n0.00 8.00 7 6 5 0.1000000014901161\n4 0 0\n-1\n");

    const auto title = [](const wchar_t* key, const wchar_t* text, const wchar_t* name) {
        FileFacts facts;
        facts.add(L"MANUFAC", L"Acme", FactKind::keyword);
        facts.add(key, text, FactKind::keyword);
        facts.add(L"auxValue1", -1);
        facts.add(L"unitTriple", std::array{1.0f, 1.0f, 1.01f});
        TbtFileRecord record;
        tbtCarry(facts, name, record);
        EXPECT_EQ(record.auxValue1 + record.unitTriple[2], 2);
        return record.title;
    };
    EXPECT_EQ(title(L"title", L"a\tb", L"n"), L"a b");
    EXPECT_EQ(title(L"title", L"/* a", L"n"), L"n");
    EXPECT_EQ(title(L"LUMINAIRE", L"Spot 7", L"n"), L"Spot 7");
    EXPECT_EQ(title(L"LUMINAIRE", L" ", L"\nn"), L"[MANUFAC] Acme");
}

}  // namespace
}  // namespace OvPhotometrics
