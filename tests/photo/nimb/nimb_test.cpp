#include <limits>

#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/distributions/web.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

using Values = std::vector<std::int16_t>;
using Lines = std::array<std::wstring, 4>;

const std::string head = "   1   0  90  90  45  90   0   0   0NIMB";  // three values
const std::string lines = "a\nb\nc\nd\n";

class Nimb : public FormatTest<NimbFormat> {
protected:
    NimbRecord sampled(Ov::RnIntensityDist& dist, float flux = 1000) {
        dist.setFlux(flux);
        NimbRecord sample;
        EXPECT_TRUE(nimbRecordFromDistribution(dist, sample));
        return sample;
    }
};

TEST_F(Nimb, EachFaultHasItsMessage) {
    const Refusal cases[] = {
        {"", "12897 1 12970"},
        {"\n", "12897 1 12971 0"},
        {"   1   0  90  90  45  90   0   0   0NIM\n", "12897 1 12971 9"},
        {"   1   0  90  90  45  90   0   0   0 NIMB\n", "12897 1 12972"},
        {head + "\na\nb\n", "12897 4 12970"},
        {"   1 350  90  15  45  90   0   0   0NIMB\n" + lines, "12897 5 12973 350"},
        {"   1   0 181  90  45  90   0   0   0NIMB\n" + lines, "12897 5 12974 181"},
        {"   1   0  90   0   7  90   0   0   0NIMB\n" + lines, "12897 5 12975 0"},
        {"   1   0  90  90      90   0   0   0NIMB\n" + lines, "12897 5 12976 -1"},
        {"   1   0  90  90   7  90   0   0   0NIMB\n" + lines, "12897 5 12976 7"},
        {"   1   0  90  90  45  45   0   0   0NIMB\n" + lines, "12897 5 12977 45"},
        {head + "           4  -2\n" + lines, "12897 5 12978 4"},
        {head + "           3  -2\n" + lines, "12897 5 12979 -2"},
        {head + "\n" + lines, "12897 6 12970"},
        {head + "\n" + lines + "   1   2\n", "12897 6 12980 2"},
        {head + "\n" + lines + "   1   2   3   4\n", "12897 6 12980 4"},
    };
    refuses(head + "\n" + lines + "   1  20 300", cases);
    const std::string start = head + std::string(32, '\n');
    contentTestIs(true, {start});
    contentTestIs(false, {" " + start, start.substr(1)});
}

TEST_F(Nimb, FieldsAndLines) {
    ASSERT_TRUE(read("  -1   0  90  90  15   0   x -12    NIMB1234 678    \n" + std::string(80, 'x') +
                     "\r\n\n\tb\rd\n9999      -512 4x  7   --999"))
        << log.take();
    EXPECT_EQ(rec.values, (Values{9999, -1, -5, 4, 7, 0, -999}));
    EXPECT_EQ(rec.lines, (Lines{std::wstring(72, L'x'), L"", L"\tb", L"d"}));
    EXPECT_EQ(rec.identifier, 12340678);
    EXPECT_EQ((std::array{rec.spare1, rec.spare2, rec.spare3, rec.symmetryCode1}), (std::array{0, -12, -1, -1}));
    ASSERT_TRUE(read(head + "           3\n" + lines + "   1  20 300"));  // one code of two
    EXPECT_EQ(rec.symmetryCode1, 3);
}

TEST_F(Nimb, WhatIsWrittenReadsBack) {
    const int cases[][7] = {// identifier, psiMax, psiStep, thetaMax, thetaStep, symmetry, lines of values
                            {0, 0, 90, 90, 90, 3, 1},     {9999, 90, 90, 144, 9, 2, 2},
                            {10000, 0, 5, 180, 5, 3, 3},  {12345678, 345, 15, 180, 45, 0, 8},
                            {7, 180, 1, 180, 1, 1, 1928}, {99999999, 270, 90, 90, 5, 0, 5}};
    for (const auto& [identifier, psiMax, psiStep, thetaMax, thetaStep, symmetry, valueLines] : cases) {
        SCOPED_TRACE(identifier);
        NimbRecord whole{identifier, psiMax, thetaMax, psiStep, thetaStep, -180, symmetry, -1, 0, -999};
        whole.lines = {L"a", L"", std::wstring(72, L'y'), L"\u00e4\tz"};
        for (int k = 0; k < whole.valueCount(); ++k)
            whole.values.push_back(static_cast<std::int16_t>(9999 - k * 79 % 10999));
        const std::string text = written(whole);
        EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 5 + valueLines);
        EXPECT_TRUE(read(text)) << log.take();
        EXPECT_EQ(rec, whole);
        EXPECT_EQ(imported(text)->getSymmetry(), PhotoWebSymmetry{symmetry});
    }
}

TEST_F(Nimb, WritingKeepsTheColumns) {
    rec.lines = {std::wstring(80, L'x'), L"", L"", L"a\nb\rc"};
    rec.values = {-32768, 32767};
    EXPECT_EQ(written(rec), "   0   0  90  90  90  90   0   0   0NIMB                \n" + std::string(72, 'x') +
                                "\n\n\na b c\n-9999999\n");
    std::ostringstream full;
    full.setstate(std::ios::badbit);
    Ov::RnStream stream(Ov::rnCreate<Ov::RnOutBuffer>(&full).get(), Form::text);
    EXPECT_FALSE(nimbWrite(rec, stream));
    EXPECT_EQ(log.take(), "12981");
    for (auto number : {&NimbRecord::identifier, &NimbRecord::spare3, &NimbRecord::psiStep})
        for (const int value : {-1000, 100000000}) {
            NimbRecord wide = rec;
            wide.*number = value;
            EXPECT_EQ(written(wide), "");
            EXPECT_EQ(log.take(), "12981");
        }
}

TEST_F(Nimb, BecomesATurnedWeb) {
    rec = {.psiMax = 345, .thetaMax = 180, .psiStep = 15, .thetaStep = 45};
    for (int k = 1; k <= 24 * 5; ++k) rec.values.push_back(static_cast<std::int16_t>(k));
    for (const int orientation : {90, 0, -90, 180, -180}) {
        rec.orientationAngle = orientation;
        const auto web = imported(written(rec));
        ASSERT_TRUE(web) << log.take();
        EXPECT_EQ(web->hasIdentityOrientation(), orientation == 90);
        const auto light = makeWebDistribution(*web);
        for (int i = 0; i < 24; ++i)
            EXPECT_NEAR(light->intensityAtUnit(direction(135, 15 * i - (90 - orientation))), 3 * 24 + i + 1, 0.01);
    }
}

TEST_F(Nimb, ChoosesItsGrid) {
    const auto spot = Ov::rnCreate<Spotlight>();
    spot->setHotspotCosine(0.9999f);
    const int steps[][2] = {{5, 90}, {15, 90}, {25, 10}, {35, 6}, {55, 3}, {89, 2}};
    for (const auto& [falloff, step] : steps) {
        spot->setFalloffCosine(static_cast<float>(std::cos(inRadians(falloff))));
        EXPECT_EQ(sampled(*spot).thetaStep, step) << falloff;
    }
    const struct {
        IesText file;
        std::array<int, 4> grid;
    } webs[] = {{{.vertical = {0, 45, 90}}, {18, 90, 90, 0}},
                {{.vertical = {0, 10, 20, 90}, .horizontal = {0, 22.5, 45, 67.5, 90}}, {3, 90, 6, 90}},
                {{.horizontal = {0, 90, 180}}, {45, 180, 45, 180}},
                {{.vertical = {0, 1, 180}, .horizontal = {0, 5, 360}}, {1, 180, 5, 355}},
                {{.horizontal = {0, 8, 360}}, {45, 180, 6, 354}}};
    for (const auto& c : webs) {
        const NimbRecord sample = sampled(*distributionOf(*import(c.file.text())));
        EXPECT_EQ((std::array{sample.thetaStep, sample.thetaMax, sample.psiStep, sample.psiMax}), c.grid);
    }
    EXPECT_THROW(nimbRecordFromDistribution(*Ov::rnCreate<Web>(), rec), Ov::ExBadCast);
}

TEST_F(Nimb, HoldsCandelaPerThousandLumens) {
    const auto lamp = Ov::rnCreate<Isotropic>();
    EXPECT_TRUE(written(sampled(*lamp, 5000))
                    .starts_with("   0   0 180  90   1  90   0   0   0NIMB           3   3\nMeasurement unknown\n"
                                 "Manufacturing company unknown\nType of luminaire unknown\n\n  80  80  80"));
    constexpr float infinity = std::numeric_limits<float>::infinity();
    for (const float flux : {0.0f, -5.0f, infinity, infinity - infinity})
        EXPECT_EQ(sampled(*lamp, flux).values, Values(181));
    const auto spot = Ov::rnCreate<Spotlight>();
    const Values wide = sampled(*spot, 2).values;
    EXPECT_EQ((Values{wide[0], wide[15], wide[31]}), (Values{943, 471, 0}));
    spot->setHotspotCosine(0.9999f);
    EXPECT_EQ(sampled(*spot).values[0], 9999);
}

TEST_F(Nimb, CarriesWhatFilesSay) {
    rec = {.identifier = 1234567, .spare3 = 3, .lines = {L"test", L"", L"lamp", L"other"}};
    FileFacts own;
    nimbDescribe(rec, own);
    NimbRecord carried;
    nimbCarry(own, L"name", carried);
    EXPECT_EQ(carried, rec);

    FileFacts other;
    other.add(L"MANUFAC", L"Maker", FactKind::keyword);
    other.add(L"LUMCAT", L"L\n1", FactKind::keyword);
    other.add(L"identifier", 100000000);
    carried.lines = {L"1", L"2", L"3", L"4"};
    nimbCarry(other, std::wstring(80, L'n'), carried);
    EXPECT_EQ(carried.lines, (Lines{L"1", L"Maker", std::wstring(72, L'n'), L"[LUMCAT] L 1"}));
    EXPECT_EQ(carried.identifier, 1234567);
}

}  // namespace
}  // namespace OvPhotometrics
