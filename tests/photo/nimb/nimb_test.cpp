#include <limits>

#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/distributions/web.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

/// The text of a NIMB file; a test sets what is odd about it.
struct NimbText {
    std::string header = "   1   0  90  90  45  90   0   0   0NIMB";
    std::string lines = "a\nb\nc\nd\n";
    std::string values = "   1  20 300\n";

    std::string text() const { return header + "\n" + lines + values; }
};

class Nimb : public Photo {
protected:
    RnRef<PhotoWebNIMB> importNimb(const std::string& text, const wchar_t* name = L"") {
        return Photo::import <NimbFormat>(text, name);
    }

    NimbRecord read(const std::string& text) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(text);
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        NimbRecord rec;
        EXPECT_TRUE(nimbRead(rec, stream)) << log.take();
        return rec;
    }

    std::string written(const NimbRecord& rec) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        return nimbWrite(rec, stream) ? io->bytes() : "";
    }

    NimbRecord sampled(Ov::RnIntensityDist& dist, float flux) {
        dist.setFlux(flux);
        NimbRecord rec;
        EXPECT_TRUE(nimbRecordFromDistribution(dist, rec));
        return rec;
    }
};

TEST_F(Nimb, EachFaultHasItsMessage) {
    const auto header = [](const char* text) { return NimbText{.header = text}.text(); };
    const struct {
        std::string text, messages;
    } cases[] = {
        {"", "12897 1 12970"},
        {header("   1   0  90  90  45  90   0   0   0NIM"), "12897 1 12971 9"},
        {header("   1   0  90  90  45  90   0   0   0 NIMB"), "12897 1 12972"},
        {NimbText{.lines = "a\nb\n", .values = ""}.text(), "12897 4 12970"},
        {header("   1 350  90  15  45  90   0   0   0NIMB"), "12897 5 12973 350"},
        {header("   1   0  89  90  45  90   0   0   0NIMB"), "12897 5 12974 89"},
        {header("   1   0 181  90  45  90   0   0   0NIMB"), "12897 5 12974 181"},
        {header("   1   0  90   0   7  90   0   0   0NIMB"), "12897 5 12975 0"},
        {header("   1   0  90  90      90   0   0   0NIMB"), "12897 5 12976 -1"},
        {header("   1   0  90  90   7  90   0   0   0NIMB"), "12897 5 12976 7"},
        {header("   1   0  90  90  45  45   0   0   0NIMB"), "12897 5 12977 45"},
        {header("   1   0  90  90  45 270   0   0   0NIMB"), "12897 5 12977 270"},
        {header("   1   0  90  90  45  90   0   0   0NIMB           4  -2"), "12897 5 12978 4"},
        {header("   1   0  90  90  45  90   0   0   0NIMB           3  -2"), "12897 5 12979 -2"},
        {NimbText{.values = "   1   2\n"}.text(), "12897 6 12980 2"},
        {NimbText{.values = "   1   2   3   4\n"}.text(), "12897 6 12980 4"},
        {header("   1 270  90  90  15  90   0   0   0NIMB"), "12897 6 12980 3"},
        {NimbText{.values = ""}.text(), "12897 6 12970"},
    };
    const auto kept = importNimb(NimbText{}.text(), L"kept");
    const std::string before = saved(*kept);
    for (const auto& c : cases) {
        SCOPED_TRACE(c.text);
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(c.text);
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        try {
            Ov::rnCast<Ov::RnPersistant>(kept.get())->load(stream, 0, L"new", nullptr);
            ADD_FAILURE() << "accepted";
        } catch (const Ov::RnStreamEx::ExReadError& error) {
            EXPECT_EQ(error.getLine(), 248);
        }
        EXPECT_EQ(log.take(), c.messages);
    }
    EXPECT_EQ(saved(*kept), before);
    EXPECT_STREQ(kept->getName(), L"kept");
}

TEST_F(Nimb, FieldsAndLines) {
    const NimbText file{.header = "  -1   0  90  90  15   0   x -12    NIMB1234 678    ",
                        .lines = std::string(80, 'x') + "\r\n\n\tb\rd\n",
                        .values = "9999      -512 4x  7   --999"};
    const NimbRecord rec = read(file.text());
    EXPECT_EQ(rec.values, (std::vector<std::int16_t>{9999, -1, -5, 4, 7, 0, -999}));
    EXPECT_EQ(rec.lines, (std::array<std::wstring, 4>{std::wstring(72, L'x'), L"", L"\tb", L"d"}));
    EXPECT_EQ(rec.identifier, 12340678);
    EXPECT_EQ(rec.orientationAngle, 0);
    EXPECT_EQ(rec.spare1, 0);
    EXPECT_EQ(rec.spare2, -12);
    EXPECT_EQ(rec.spare3, -1);
    EXPECT_EQ(rec.symmetryCode1, -1);
    EXPECT_EQ(read(NimbText{.header = "  -1   0  90  90  45  90   0   0   0NIMB"}.text()).identifier, 0);
}

TEST_F(Nimb, WhatIsWrittenReadsBack) {
    NimbRecord rec;
    rec.lines = {L"a", L"", std::wstring(72, L'y'), L"\u00e4\tz"};
    rec.spare2 = -999;
    const struct {
        int identifier, psiMax, psiStep, thetaMax, thetaStep, symmetryCode, lines;
    } cases[] = {{0, 0, 90, 90, 90, -1, 1},    {9999, 90, 90, 144, 9, 2, 2},
                 {10000, 0, 5, 180, 5, 3, 3},  {12345678, 345, 15, 180, 45, 0, 8},
                 {7, 180, 1, 180, 1, 1, 1928}, {99999999, 270, 90, 90, 5, 3, 5}};
    for (const auto& c : cases) {
        SCOPED_TRACE(c.identifier);
        rec.identifier = c.identifier;
        rec.psiMax = c.psiMax;
        rec.psiStep = c.psiStep;
        rec.thetaMax = c.thetaMax;
        rec.thetaStep = c.thetaStep;
        rec.symmetryCode2 = c.symmetryCode;
        rec.values.clear();
        for (int k = 0; k < rec.valueCount(); ++k)
            rec.values.push_back(static_cast<std::int16_t>(k * 79 % 10999 - 999));
        const std::string text = written(rec);
        EXPECT_EQ(std::count(text.begin(), text.end(), '\n'), 5 + c.lines);
        EXPECT_EQ(read(text), rec);
    }
}

TEST_F(Nimb, WritingKeepsTheColumns) {
    NimbRecord rec;
    rec.lines[0] = std::wstring(80, L'x');
    rec.lines[3] = L"a\nb\rc";
    rec.values = {-32768, 32767};
    EXPECT_EQ(written(rec), "   0   0  90  90  90  90   0   0   0NIMB                \n" + std::string(72, 'x') +
                                "\n\n\na b c\n-9999999\n");
    for (std::int32_t NimbRecord::*number : {&NimbRecord::identifier, &NimbRecord::spare3, &NimbRecord::psiStep})
        for (const int value : {-1000, 100000000}) {
            NimbRecord wide = rec;
            wide.*number = value;
            EXPECT_EQ(written(wide), "");
            EXPECT_EQ(log.take(), "12981");
        }
}

/// Raises at one of its writes.
class FailingBuffer : public Ov::RnMemoryBuffer {
public:
    explicit FailingBuffer(int writes) : _left(writes) {}

protected:
    char* prepareWrite(std::size_t count) override {
        if (_left-- == 0) throw Ov::RnStreamEx::ExWriteError("tests", 1, "full");
        return RnMemoryBuffer::prepareWrite(count);
    }

private:
    int _left;
};

TEST_F(Nimb, AStreamThatFailsIsReported) {
    const auto web = importNimb(NimbText{.values = "   1   2   3"}.text());
    int failures = 0;
    for (bool done = false; !done; failures += done ? 0 : 1) {
        const auto io = Ov::rnCreate<FailingBuffer>(failures);
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        try {
            Ov::rnCast<Ov::RnPersistant>(web.get())->save(stream);
            done = true;
        } catch (const Ov::RnStreamEx::ExWriteError& error) {
            EXPECT_EQ(error.getLine(), 237);
            EXPECT_EQ(log.take(), "12981");
        }
    }
    EXPECT_GT(failures, 15);
}

TEST_F(Nimb, BecomesATurnedWeb) {
    NimbRecord rec;
    rec.psiMax = 345;
    rec.psiStep = 15;
    rec.thetaMax = 180;
    rec.thetaStep = 45;
    for (int k = 1; k <= rec.valueCount(); ++k) rec.values.push_back(static_cast<std::int16_t>(k));
    for (const int orientation : {90, 0, -90, 180, -180}) {
        SCOPED_TRACE(orientation);
        rec.orientationAngle = orientation;
        const auto web = importNimb(written(rec), L"name");
        ASSERT_TRUE(web) << log.take();
        EXPECT_STREQ(web->getName(), L"name");
        EXPECT_EQ(web->getSymmetry(), PhotoWebSymmetry::Full);
        EXPECT_EQ(web->getMaxCandela(), 120);
        EXPECT_EQ(web->hasIdentityOrientation(), orientation == 90);
        const auto light = makeWebDistribution(*web);
        for (int i = 0; i < 24; ++i) {
            EXPECT_FLOAT_EQ(web->getCandela(i, 3) * 120, static_cast<float>(3 * 24 + i + 1));
            EXPECT_NEAR(light->intensityAtUnit(direction(135, 15 * i - (90 - orientation))), 3 * 24 + i + 1, 0.01);
        }
    }
    for (const auto& [psiMax, symmetry] :
         {std::pair(0, PhotoWebSymmetry::Axial), {90, PhotoWebSymmetry::Quarter}, {180, PhotoWebSymmetry::Half}}) {
        rec.psiMax = psiMax;
        rec.values.resize(static_cast<std::size_t>(rec.valueCount()));
        EXPECT_EQ(importNimb(written(rec))->getSymmetry(), symmetry);
    }
}

TEST_F(Nimb, ChoosesItsGrid) {
    const auto spot = Ov::rnCreate<Spotlight>();
    spot->setHotspotCosine(0.9999f);
    const int steps[][2] = {{5, 90}, {15, 90}, {25, 10}, {35, 6}, {55, 3}, {89, 2}};
    for (const auto& [falloff, step] : steps) {
        spot->setFalloffCosine(static_cast<float>(std::cos(inRadians(falloff))));
        const NimbRecord rec = sampled(*spot, 1000);
        EXPECT_EQ(rec.thetaStep, step) << falloff;
        EXPECT_EQ(rec.thetaMax, 90);
    }
    const struct {
        IesText file;
        int thetaStep, thetaMax, psiStep, psiMax;
    } webs[] = {{{.vertical = {0, 45, 90}}, 18, 90, 90, 0},
                {{.vertical = {0, 10, 20, 90}, .horizontal = {0, 22.5, 45, 67.5, 90}}, 3, 90, 6, 90},
                {{.horizontal = {0, 90, 180}}, 45, 180, 45, 180},
                {{.horizontal = {0, 90, 180, 270, 360}}, 45, 180, 30, 330},
                {{.vertical = {0, 1, 180}, .horizontal = {0, 8, 360}}, 1, 180, 6, 354}};
    for (const auto& c : webs) {
        const NimbRecord rec = sampled(*distributionOf(*import(c.file.text())), 1000);
        EXPECT_EQ((std::array{rec.thetaStep, rec.thetaMax, rec.psiStep, rec.psiMax}),
                  (std::array{c.thetaStep, c.thetaMax, c.psiStep, c.psiMax}));
    }
    NimbRecord rec;
    EXPECT_THROW(nimbRecordFromDistribution(*Ov::rnCreate<Web>(), rec), Ov::ExBadCast);
}

TEST_F(Nimb, HoldsCandelaPerThousandLumens) {
    const auto lamp = Ov::rnCreate<Isotropic>();
    EXPECT_TRUE(written(sampled(*lamp, 5000))
                    .starts_with("   0   0 180  90   1  90   0   0   0NIMB           3   3\nMeasurement unknown\n"
                                 "Manufacturing company unknown\nType of luminaire unknown\n\n  80  80  80"));
    for (const float flux :
         {0.0f, -5.0f, std::numeric_limits<float>::infinity(), std::numeric_limits<float>::quiet_NaN()})
        EXPECT_EQ(sampled(*lamp, flux).values, std::vector<std::int16_t>(181));
    const auto spot = Ov::rnCreate<Spotlight>();
    const NimbRecord wide = sampled(*spot, 2);
    EXPECT_EQ(wide.values[0], 943);
    EXPECT_EQ(wide.values[15], 471);
    EXPECT_EQ(wide.values[31], 0);
    spot->setHotspotCosine(0.9999f);
    EXPECT_EQ(sampled(*spot, 1000).values[0], 9999);
    // A saved web reads back as what was written, whatever its flux was.
    const auto web = importNimb(NimbText{}.text());
    const auto again = importNimb(saved(*web));
    ASSERT_TRUE(again) << log.take();
    EXPECT_EQ(again->getMaxCandela(), std::round(300 * 1000 / web->getLumens()));
}

TEST_F(Nimb, ContentTestKeepsThePosition) {
    const std::string header = NimbText{}.header + "\n" + std::string(31, 'x');
    const std::pair<std::string, bool> cases[] = {{header, true},
                                                  {header + "more", true},
                                                  {" " + header, false},
                                                  {header.substr(0, 71), false},
                                                  {"", false}};
    for (const auto& [text, accepted] : cases) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>("??" + text);
        io->seek(2, 0);
        EXPECT_EQ(immortal<NIMBBuilder>().canImport(static_cast<Ov::RnBufferedIO*>(io.get())), accepted) << text;
        EXPECT_EQ(io->seek(0, 1), 2);
    }
}

TEST_F(Nimb, CarriesWhatFilesSay) {
    const NimbRecord rec = read(NimbText{.header = "  -1   0  90  90  45   0   1   2   3NIMB 1234567   0   3",
                                         .lines = "test\n\nlamp\nother\n"}
                                    .text());
    FileFacts own;
    nimbDescribe(rec, own);
    NimbRecord carried;
    carried.lines = {L"1", L"2", L"3", L"4"};
    nimbCarry(own, L"name", carried);
    EXPECT_EQ(carried.lines, rec.lines);
    EXPECT_EQ(carried.identifier, 1234567);
    EXPECT_EQ(carried.spare3, 3);

    FileFacts other;
    other.add(L"MANUFAC", L"Maker");
    other.add(L"LUMCAT", L"L\n1");
    other.add(L"identifier", 100000000);
    carried.lines = {L"1", L"2", L"3", L"4"};
    nimbCarry(other, std::wstring(80, L'n'), carried);
    EXPECT_EQ(carried.lines,
              (std::array<std::wstring, 4>{L"1", L"Maker", std::wstring(72, L'n'), L"[LUMCAT] L 1"}));
    EXPECT_EQ(carried.identifier, 1234567);
    other.add(L"LUMINAIRE", L"Lamp");
    nimbCarry(other, L"name", carried);
    EXPECT_EQ(carried.lines[2], L"Lamp");
}

}  // namespace
}  // namespace OvPhotometrics
