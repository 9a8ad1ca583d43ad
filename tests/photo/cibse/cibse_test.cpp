#include "components/photo/cibse/photoWebCIBSE.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

using Labels = std::array<std::wstring, 7>;

using Cibse = FormatTest<CibseFormat>;

const std::string head = "CIBSE/1 and more\nMaker\n\n\n\n\n\n\n";

TEST_F(Cibse, EachFaultHasItsMessage) {
    const Refusal cases[] = {
        {"cibse/1\n", "12945 12989"},
        {"CIBSE/1\n\n", "12945 12947  ; 12945 12959 0"},
        {head + "1 3", "12945 12962 3"},
        {head + "1 1 0 +1 0", "12945 12948 +; 12945 12964"},
        {head + "1 1 0 0 0 1 0", "12945 12948  ; 12945 12965"},
        {head + "1 1 0 0 0 1 0 0 a", "12945 12948 a; 12945 12990"},
        {head + "1 1 0 0 0 1 0 0 0 1", "12945 12960 1"},
        {head + "1 1 0 0 0 1 0 0 0 40000 40000 0 1", "12945 12948  ; 12945 12966"},
        {head + "1 1 0 0 0 1 0 0 0 2 1 0 90 0 1 1 99 x 0 1e99", "12945 12948 x; 12945 12946; 12945 12991"},
        {cibseText(1, {0, 90}, {0, 90, 45}), "12944"},
        {cibseText(2, {0, 90}, {270, 0, 90}), "12944"},
        {cibseText(1, {0, 120}, {0}), "12985"},
        {cibseText(1, {0, 90}, {0, 90.06}), "12986 90.06"},
        {cibseText(1, {0, 90}, {90, 180}), "12987 90"},
        {cibseText(1, {0, 90}, {270}), "12935"},
        {cibseText(1, {0, 90}, {270, 0, 300, 90}), "12926; 12935"},
        {cibseText(2, {-91, 0}, {0, 90}), "12982"},
        {cibseText(2, {-90, 90}, {0}), "12983"},
        {cibseText(2, {-90, 90}, {0, 91}), "12984"},
    };
    refuses(cibseText(1, {0, 90}, {0}), cases);
    contentTestIs(true, {"CIBSE/1"});
    contentTestIs(false, {"", "CIBSE/", " CIBSE/1"});
}

TEST_F(Cibse, SavesGridsThatFitAndSamplesOthers) {
    const std::string first = "CIBSE/1\n \n \n \n \n \n \n \n1 ";
    const std::string factors = " 0 0 0\n1 0 0\n0.00\n";
    const auto web = imported(cibseText(1, {0, 180}, {0, 90}));
    const auto light = distributionOf(*web);
    light->setFlux(2000);
    ASSERT_TRUE(cibseRecordFromDistribution(*light, rec));
    EXPECT_EQ(rec.grid.candelas, (std::vector<float>{0.5f / 12, 1 / 12.0f, 5.5f / 12, 0.5f}));
    EXPECT_TRUE(saved(*web).starts_with(first + "1" + factors + "2 2\n 0.00 180.00\n 0.00 90.00\n "));
    EXPECT_TRUE(saved(*imported(cibseText(2, {-30, 30}, {-70, 50})))
                    .starts_with(first + "2" + factors + "2 2\n 60.00 120.00\n -60.00 60.00\n "));
    EXPECT_EQ(saved(*immortal<CIBSEBuilder>().create()),
              first + "2" + factors + "2 1\n 0.00 180.00\n 0.00\n 0.00 0.00\n99 0 0 0\n");

    using enum PhotoWebSymmetry;
    for (const auto& [symmetry, lastPsi, planes] : {std::tuple(Half, 180, 19), {Quarter, 90, 10}}) {
        PhotoWebRecord other;
        photoWebRecordInit(other, 2, 2, symmetry, false, false, nullptr);
        for (int i = 0; i < 2; ++i) {
            photoWebRecordSetTheta(other, i, toRadians(20 + 100 * i));
            photoWebRecordSetPsi(other, i, toRadians(lastPsi * i));
            for (int j = 0; j < 2; ++j) photoWebRecordSetCandela(other, i, j, 8);
        }
        ASSERT_TRUE(photoWebInstall(*web, other));
        const auto again = imported(saved(*web));
        ASSERT_TRUE(again) << log.take();
        EXPECT_EQ(again->getSymmetry(), symmetry);
        EXPECT_EQ(again->getPsiCount() * 100 + again->getThetaCount(), planes * 100 + 19);
        EXPECT_NEAR(again->getMaxCandela(), 8000 / web->getLumens(), 0.01);
    }
}

TEST_F(Cibse, RecordsAndFactsReadBackAsWritten) {
    ASSERT_TRUE(candelaGridAlloc(rec.grid, 46, 3));
    std::fill(rec.grid.candelas.begin(), rec.grid.candelas.end(), -1.5f);  // 13 in a line
    rec.labels = {L"Maker", L"", std::wstring(70, L'x'), L"two\r\nlines", L" z"};
    rec.leadInteger = 7;
    rec.leadValues = {0.1f, 2, 3};
    rec.factors = {4, 5, 6};
    rec.singleValue = 7.25f;
    rec.trailerInteger = -8;
    rec.trailerValues = {9, 10, 11};
    const CibseRecord whole = rec;
    const std::string text = written(whole);
    ASSERT_TRUE(read(text)) << log.take();
    EXPECT_EQ(rec.labels, (Labels{L"Maker", L" ", std::wstring(60, L'x'), L"two  lines", L" z", L" ", L" "}));
    EXPECT_EQ(rec.grid.candelas, whole.grid.candelas);
    EXPECT_EQ(longestLine(text), 78u);  // a line of angles would have 79

    FileFacts facts, again;
    CibseRecord carried;
    cibseDescribe(rec, facts);
    cibseCarry(facts, L"name", carried);
    EXPECT_EQ(carried.labels, (Labels{L"Maker", L"", std::wstring(60, L'x'), L"two  lines", L" z"}));
    EXPECT_EQ(carried.factors[0], 1);
    carried.factors[0] = 4;
    cibseDescribe(carried, again);
    EXPECT_TRUE(std::equal(facts.begin(), facts.end(), again.begin(), again.end(),
                           [](auto& a, auto& b) { return a.key == b.key && a.text == b.text; }));
}

TEST_F(Cibse, LabelsAreLinesOrPiecesOfThem) {
    ASSERT_TRUE(
        read("CIBSE/1\r\na\r\n\r\n" + std::string(70, 'x') + "\n\n\n\n1 1 0 0 0 1 0 0 0 2 1 0 90 0 1 1 0 0 0 0"));
    EXPECT_EQ(rec.labels, (Labels{L"a", L"", std::wstring(60, L'x'), std::wstring(10, L'x')}));
    FileFacts other;
    other.add(L"MANUFAC", L"0", FactKind::keyword);
    for (int i = 1; i < 9; ++i) other.add(L"line", std::to_wstring(i), FactKind::label);
    CibseRecord named, unnamed;
    cibseCarry(other, L"name", named);
    EXPECT_EQ(named.labels, (Labels{L"name", L"[MANUFAC] 0", L"1", L"2", L"3", L"4", L"5"}));
    cibseCarry(other, L"MANU", unnamed);
    EXPECT_EQ(unnamed.labels[0], L"[MANUFAC] 0");
}

}  // namespace
}  // namespace OvPhotometrics
