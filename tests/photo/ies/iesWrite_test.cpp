#include "components/photo/distributions/isotropic.h"
#include "tests/photo/photoFixture.h"

// What a save writes, and that it reads back.

namespace OvPhotometrics {
namespace {

using IesWrite = FormatTest<IesFormat>;

const char* const head = "IESNA91\n[TEST]     Test unknown\n[MANUFAC]  Manufacturing company unknown\nTILT=NONE\n";

TEST_F(IesWrite, CopiesAGridWithRelativeValues) {
    const auto web =
        import(IesText{.vertical = {0, 45, 90}, .horizontal = {0, 180}, .values = "8 4 1 8 0.1 -1"}.text());
    EXPECT_EQ(saved(*web), std::string(head) +
                               "1 1000.00 1\n3 2\n1\n2\n0 0 0\n1 1 0\n 0.00 45.00 90.00\n 0.00 180.00\n"
                               " 1.00 0.50 0.12\n 1.00 0.01 -0.12\n");
}

TEST_F(IesWrite, CentresALateralGrid) {
    const std::string text =
        saved(*import(IesText{.type = 3, .vertical = {-30, 0, 30}, .horizontal = {-70, -10, 50}}.text()));
    EXPECT_NE(text.find("\n3\n2\n0 0 0\n1 1 0\n 60.00 90.00 120.00\n -60.00 0.00 60.00\n"), std::string::npos)
        << text;
    const auto oneSide = import(IesText{.type = 2, .vertical = {-30, 0, 30}, .horizontal = {0, 90}}.text());
    EXPECT_NE(saved(*oneSide).find("3 2\n3\n"), std::string::npos);
}

TEST_F(IesWrite, SamplesWhatDoesNotFit) {
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

TEST_F(IesWrite, ASavedGridSavesTheSameAgain) {
    for (const IesText& file :
         {IesText{.vertical = {0, 22.125, 90}, .horizontal = {0, 30.5, 90}}, IesText{.horizontal = {90, 180, 270}},
          IesText{.lumens = -1, .horizontal = {0, 90, 180, 270, 360}}}) {
        const std::string first = saved(*import(file.text()));
        const auto again = import(first);
        ASSERT_TRUE(again) << log.take();
        EXPECT_EQ(saved(*again), first);
    }
}

TEST_F(IesWrite, BreaksListsBeforeTheirLimit) {
    ASSERT_TRUE(candelaGridAlloc(rec.grid, 100, 3));
    const std::string text = written(rec);
    EXPECT_EQ(longestLine(text), 132u);
    const std::string lists = text.substr(text.find("\n 0.00"));
    EXPECT_EQ(std::count(lists.begin(), lists.end(), ' '), 100 + 3 + 300);
}

TEST_F(IesWrite, TiltAndEmptyRecords) {
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
