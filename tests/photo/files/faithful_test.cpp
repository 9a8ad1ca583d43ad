#include <cmath>
#include <limits>

#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/distributions/diffuse.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/distributions/web.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "components/photo/tbt/photoWebTBT.h"
#include "tests/photo/photoFixture.h"

// Files for other programs: what every format writes faithfully.

namespace OvPhotometrics {
namespace {

class Faithful : public Photo {
protected:
    template <class Format>
    std::string written(Ov::RnIntensityDist& dist, const FileFacts& facts = {}) {
        return fileOf(immortal<PhotoWebBuilder<Format>>(), dist, facts);
    }

    static FileFacts describe(Ov::RnPhotoFormat& format, const std::string& text) {
        FileFacts facts;
        auto visitor = Ov::rnVisitor<const FileFact&>(
            [&](const FileFact& fact) { facts.add(fact.key, std::wstring(fact.text), fact.kind); });
        EXPECT_TRUE(format.readFacts(*Ov::rnCreate<Ov::RnMemoryBuffer>(text), nullptr, visitor)) << text;
        return facts;
    }

    /// The largest difference of what a format's file gives, of the peak, over the sphere in the host frame. Where
    /// the source jumps to dark or back within `rim` degrees there is none.
    template <class Format>
    double loss(Ov::RnIntensityDist& dist, double peak, double rim = 1.5) {
        const auto web = import <Format>(written<Format>(dist), L"", L"");
        if (!web) return std::numeric_limits<double>::infinity();
        const auto inCandela = web->inCandela();
        const auto again = distributionOf(*inCandela);
        again->setPeakIntensity(inCandela->getMaxCandela());
        double worst = 0;
        for (double theta = 0.3; theta < 180; theta += 2.9)
            for (double psi = 0.3; psi < 360; psi += 4.7) {
                if (nearRim(dist, theta, psi, rim)) continue;
                const auto d = direction(theta, psi);
                worst = std::max(worst, std::fabs(double(dist.intensityAt(d)) - again->intensityAt(d)));
            }
        return worst / peak;
    }

    static bool nearRim(const Ov::RnIntensityDist& dist, double theta, double psi, double rim) {
        const double sine = std::max(std::sin(inRadians(theta)), 0.02);
        int lit = 0;
        for (const auto& [t, p] : {std::pair(-1, 0), {1, 0}, {0, -1}, {0, 1}, {0, 0}})
            lit += dist.intensityAt(direction(theta + t * rim, psi + p * rim / sine)) > 0;
        return lit != 0 && lit != 5;
    }
};

/// What stands in a file's grid.
template <class Record>
std::string gridOf(const Record& rec) {
    const auto list = [](const std::vector<float>& angles) {
        std::string text;
        for (const float angle : angles) text += Ov::toUtf8(numbersText({angle}, FileForm::faithful)) + " ";
        return text;
    };
    return std::to_string(static_cast<int>(rec.photometricType)) + ": " + list(rec.grid.verticalAngles) + "| " +
           list(rec.grid.horizontalAngles);
}

/// The grid that a record made faithfully of a source's web has.
template <class Target, class Source>
std::string copied(Source& web) {
    typename Target::Record rec;
    const auto dist = makeWebDistribution(web);
    return Target::fromDistributionFaithfully(*dist, rec) ? gridOf(rec) : "";
}

TEST_F(Faithful, GridsThatAFormatHoldsAreCopiedAndOthersSampled) {
    const std::vector<double> up{0, 22.5, 45, 90};
    const std::string v = ": 0 22.5 45 90 | ";
    const struct {
        IesText source;
        std::string ies, cibse;  // beginnings
    } cases[] = {
        {{.vertical = up, .horizontal = {0}}, "1" + v + "0 ", "1" + v + "0 "},
        {{.vertical = up, .horizontal = {0, 45, 90}}, "1" + v + "0 45 90 ", "1" + v + "0 45 90 "},
        {{.vertical = up, .horizontal = {90, 180, 270}}, "1" + v + "90 180 270 ", "1" + v + "90 180 270 "},
        {{.vertical = up, .horizontal = {0, 90, 210}}, "1" + v + "0 90 210 360 ", "1" + v + "0 90 210 360 "},
        {{.vertical = {0, 45, 90.1}, .horizontal = {0}},
         "1: 0 45 90.1 | 0 ",
         "1: 0 45 90.1 90.101 90.102 90.103 180 | 0 "},
        {{.vertical = {0, 1.0 / 3, 2.8125, 13.137, 45.3123, 63.62571, 90}, .horizontal = {0, 120.0625, 200.717}},
         "1: 0 0.33333334 2.8125 13.137 45.3123 63.62571 90 | 0 120.0625 200.717 360 ",
         "1: 0 0.33333334 2.8125 13.137 45.3123 63.62571 90 | 0 120.0625 200.717 360 "},
        {{.type = 3, .vertical = {-90, 0, 30}, .horizontal = {0, 60}},
         "3: -90 0 30 | 0 60 ",
         "1: 0 90 120 120.001 120.002 120.003 180 | 0 60 60.001 60.002 60.003 180 "},
        {{.type = 3, .vertical = {-90, 0, 30}, .horizontal = {-20.317, 0, 60}},
         "3: -90 0 30 | -20.317 0 60 ",
         "1: 0 90 120 120.001 120.002 120.003 180 | 270 339.68 339.681 339.682 339.683 0 60 60.001 60.002 60.003 "
         "270 "},
        {{.type = 2, .vertical = {-90, 0, 90}, .horizontal = {-45.137, 7.723, 90}},
         "2: -90 0 90 | -45.137 7.723 90 ",
         "2: -90 0 90 | -90 -45.14 -45.139 -45.138 -45.137 7.723 89.997 89.998 89.999 90 "},
    };
    for (const auto& c : cases) {
        const auto web = import(c.source.text());
        ASSERT_TRUE(web);
        EXPECT_TRUE(copied<IesFormat>(*web).starts_with(c.ies)) << copied<IesFormat>(*web);
        EXPECT_TRUE(copied<CibseFormat>(*web).starts_with(c.cibse)) << copied<CibseFormat>(*web);
    }
    const struct {
        int type;
        std::vector<double> vertical, horizontal;
        std::string grid, ies, values = {};
    } cibseCases[] = {
        // Planes from 270 are none of IES: sampled, the vertical angles kept.
        {1, {0, 40, 90}, {270, 300, 0, 90}, "1: 0 40 90 | 270 300 0 90 ", "1: 0 40 90 | 0 "},
        {1, {0, 40, 90}, {270, 0, 90, 180, 270}, "1: 0 40 90 | 270 0 90 180 270 ", "1: 0 40 90 | 0 "},
        {1, {0, 40, 90}, {270, 0, 100}, "1: 0 40 90 | 270 0 100 270 ", "1: 0 40 90 | 0 "},
        {2, {-90, 0, 90}, {0, 45, 90}, "2: -90 0 90 | 0 45 90 ", "1: 0 90 180 | 0 0.12 0.24 "},
        {2, {-90, 0, 90}, {-30, 0, 60.5}, "2: -90 0 90 | -30 0 60.5 ", "1: 0 1 2 "},
        {2, {-90, 90}, {-30, 0, 60}, "2: -90 90 | -30 0 60 ", "2: -90 90 | -30 0 60 ", "0 0 7 9 0 0 "},
    };
    for (const auto& c : cibseCases) {
        const auto web = import <CibseFormat>(cibseText(c.type, c.vertical, c.horizontal, c.values));
        ASSERT_TRUE(web) << c.grid << log.take();
        EXPECT_EQ(copied<CibseFormat>(*web), c.grid);
        EXPECT_TRUE(copied<IesFormat>(*web).starts_with(c.ies)) << copied<IesFormat>(*web);
    }
}

/// The text of a TBT circle.
std::string tbtCircle(int verticalCount, int planes) {
    std::string text =
        "t\n3\n1 1 1\n1000 1000 1 1 5 0\n4 " + std::to_string(verticalCount) + " " + std::to_string(planes) + "\n";
    for (int h = 0; h < planes; ++h)
        for (int v = 0; v < verticalCount; ++v)
            text += std::to_string(100 + 9 * v + 15 * (h % (planes - 1) * 7 % 4)) + " ";
    return text + "-1\n";
}

TEST_F(Faithful, LightIsKeptBetweenTheAnglesAndUpToTheRim) {
    const std::vector<double> fine{0, .125, .25, .375, .5, .625, .75, .875, 1, 1.125, 1.25, 45, 90};
    const std::string beam = "1000 960 850 690 520 360 230 130 70 30 9 2 1 ";
    const std::vector<double> lateral{-30, -10, 10, 30};
    const std::string darkCircle =
        "t\n3\n1 1 1\n1000 1000 1 1 5 0\n4 5 5 50 90 80 30 20 50 0 0 0 20 50 0 60 0 20 50 0 0 40 20 50 90 80 30 "
        "20 -1";
    const std::vector<double> odd{-30.0625, -9.7, 1.0 / 3, 30};
    const struct {
        const char* name;
        RnRef<Ov::RnPhotoWebData> web;
    } sources[] = {
        {"circle of 5 planes", import <TbtFormat>(tbtCircle(5, 5))},
        {"circle of 12 planes", import <TbtFormat>(tbtCircle(8, 12))},
        {"circle of 25 planes", import <TbtFormat>(tbtCircle(13, 25))},
        {"fine beam", import(IesText{.vertical = fine, .horizontal = {0}, .values = beam}.text())},
        {"A", import(IesText{.type = 3, .vertical = lateral, .horizontal = {-45, 0, 45}}.text())},
        {"A, odd", import(IesText{.type = 3, .vertical = odd, .horizontal = odd}.text())},
        {"A, one side", import(IesText{.type = 3, .vertical = lateral, .horizontal = {0, 30, 60}}.text())},
        {"A, hemisphere", import(IesText{.type = 3, .vertical = lateral, .horizontal = {-90, 0, 90}}.text())},
        {"B", import(IesText{.type = 2, .vertical = lateral, .horizontal = {-45, 0, 45}}.text())},
        {"B, odd", import(IesText{.type = 2, .vertical = odd, .horizontal = odd}.text())},
        {"B, hemisphere", import(IesText{.type = 2, .vertical = lateral, .horizontal = {-90, 0, 90}}.text())},
        {"circle, dark in places", import <TbtFormat>(darkCircle)},
        {"from 270", import <CibseFormat>(cibseText(1, {0, 40, 90}, {270, 320, 0, 40, 100}))},
    };
    for (const auto& [name, web] : sources) {
        ASSERT_TRUE(web) << name << log.take();
        const auto dist = distributionOf(*web);
        EXPECT_LT(loss<IesFormat>(*dist, web->getMaxCandela(), 0.02), 0.001) << name;
        EXPECT_LT(loss<CibseFormat>(*dist, web->getMaxCandela(), 0.02), 0.001) << name;
    }
    // Within the rims, in even grids, too.
    const std::vector<double> down{0, 15, 30, 45, 60, 75, 90};
    for (const IesText& source :
         {IesText{.lumens = 800, .vertical = down},
          IesText{.lumens = 800, .vertical = down, .horizontal = {0, 45, 90}},
          IesText{.lumens = -1, .vertical = down, .horizontal = {90, 180, 270}},
          IesText{.lumens = 3000, .vertical = {90, 120, 180}, .horizontal = {0, 120, 240}},
          IesText{.lumens = 90, .vertical = {0, 45, 90, 135, 180}, .values = "60 90 -30 -30 20"},
          IesText{.type = 3, .lumens = 500, .vertical = {-40, 0, 40}, .horizontal = {0, 30, 60}}}) {
        const auto web = import(source.text());
        const auto dist = distributionOf(*web);
        const double peak = web->getMaxCandela();
        EXPECT_LT(loss<IesFormat>(*dist, peak), 5e-6) << source.text();
        EXPECT_LT(loss<NimbFormat>(*dist, peak), 0.003 + 0.75 / peak) << source.text();
        EXPECT_LT(loss<TbtFormat>(*dist, peak), 0.003 + 5e-6 * web->getLumens() / peak) << source.text();
    }
}

/// Sums over the middles of cells of a degree.
double fluxOf(const Ov::RnIntensityDist& dist) {
    double sum = 0;
    for (double theta = 0.5; theta < 180; ++theta)
        for (double psi = 0.5; psi < 360; ++psi)
            sum += std::sin(inRadians(theta)) * dist.intensityAt(direction(theta, psi));
    return sum * inRadians(1) * inRadians(1);
}

TEST_F(Faithful, RimsKeepTheirFluxOnEvenGrids) {
    for (const int type : {2, 3})
        for (const std::vector<double>& horizontal : {std::vector<double>{-45, 0, 45}, {0, 30, 60}}) {
            const IesText text{.type = type,
                               .vertical = {-30, 0, 30},
                               .horizontal = horizontal,
                               .values = "900 950 920 930 1000 990 940 960 910 "};
            const auto web = import(text.text());
            const auto dist = distributionOf(*web);
            dist->setFlux(web->getLumens());
            const double expected = fluxOf(*dist) / web->getMaxCandela();
            for (const auto& again :
                 {RnRef<Ov::RnPhotoWebData>(import <TbtFormat>(written<TbtFormat>(*dist))),
                  RnRef<Ov::RnPhotoWebData>(import <NimbFormat>(written<NimbFormat>(*dist)))}) {
                EXPECT_NEAR(fluxOf(*distributionOf(*again)) / again->getMaxCandela() / expected, 1, 0.002)
                    << text.text();
            }
        }
}

TEST_F(Faithful, NumbersAreTheShortestThatReadBackAndTheFluxIsTheirs) {
    for (const float lumens : {0.015f, 0.4f, 3.3f, 123456.7f}) {
        const auto light = Ov::rnCreate<Isotropic>();
        light->setFlux(lumens);
        const auto tbt = import <TbtFormat>(written<TbtFormat>(*light));
        EXPECT_EQ(tbt->getLumens(), light->getFlux());
        EXPECT_NEAR(tbt->getMaxCandela() * lumens / 1000 / light->getPeakIntensity(), 1, 5e-6);
        EXPECT_EQ(import(written<IesFormat>(*light))->getLumens(), light->getFlux());
    }
    for (const float candela : {2e-30f, 0.00123456f, 1.23456f, 1999.99f, 123456.0f, 3e20f}) {
        const auto light = Ov::rnCreate<Isotropic>();
        light->setPeakIntensity(candela);
        EXPECT_NEAR(import(written<IesFormat>(*light))->getMaxCandela() / candela, 1, 5e-6);
        EXPECT_NEAR(import <CibseFormat>(written<CibseFormat>(*light))->getMaxCandela() / candela, 1, 5e-6);
    }
    const auto light = Ov::rnCreate<Isotropic>();
    light->setPeakIntensity(250.5);
    FileFacts facts;
    facts.add(L"height", -0.094f);
    facts.add(L"watts", 1234567.0f);
    const std::string ies = written<IesFormat>(*light, facts);
    EXPECT_NE(ies.find(" 0.1\n"), std::string::npos) << ies;
    EXPECT_NE(ies.find("\n0 0 -0.094\n1 1 1234567\n"), std::string::npos) << ies;
    EXPECT_NE(ies.find("\n 2505 2505"), std::string::npos) << ies;
    light->setPeakIntensity(0.12345678f);
    EXPECT_NE(written<IesFormat>(*light).find("\n 12345.68"), std::string::npos);
}

TEST_F(Faithful, FormulasBecomeFiles) {
    const auto isotropic = Ov::rnCreate<Isotropic>();
    const auto diffuse = Ov::rnCreate<Diffuse>();
    std::vector<RnRef<Ov::RnIntensityDist>> lights{isotropic, diffuse};
    for (const auto& [hotspot, falloff] : {std::pair(8, 60), {10, 20}, {2, 90}, {45, 45}, {60, 30}, {89, 90}}) {
        const auto spotlight = Ov::rnCreate<Spotlight>();
        spotlight->setHotspotCosine(static_cast<float>(std::cos(inRadians(hotspot))));
        spotlight->setFalloffCosine(static_cast<float>(std::cos(inRadians(falloff))));
        lights.push_back(spotlight);
    }
    for (const auto& dist : lights) {
        dist->setFlux(1200);
        EXPECT_FLOAT_EQ(dist->getFlux(), 1200);
        EXPECT_LT(loss<IesFormat>(*dist, dist->getPeakIntensity()), 0.001);
        EXPECT_LT(loss<CibseFormat>(*dist, dist->getPeakIntensity()), 0.001);
        const auto web = import(written<IesFormat>(*dist));
        EXPECT_EQ(web->getLumens(), 1200);
        EXPECT_NEAR(web->getLuminaireLumens(), 1200, 4) << "the flux is the integral of the light";
    }
}

TEST_F(Faithful, NothingIsWrittenThatItsReaderRefuses) {
    const auto light = Ov::rnCreate<Isotropic>();
    light->setPeakIntensity(std::numeric_limits<float>::infinity());
    EXPECT_EQ(written<IesFormat>(*light), "");
    EXPECT_EQ(written<CibseFormat>(*light), "");
    EXPECT_NE(log.take(), "");
    FileFacts facts;
    facts.add(L"leadInteger", -4);
    facts.add(L"kindCode", 9);
    facts.add(L"identifier", 123456789);
    facts.add(L"title", L" /* no title\n7", FactKind::label);
    light->setPeakIntensity(80);
    EXPECT_TRUE(import <CibseFormat>(written<CibseFormat>(*light, facts)));
    EXPECT_TRUE(import <NimbFormat>(written<NimbFormat>(*light, facts)));
    EXPECT_TRUE(import <TbtFormat>(written<TbtFormat>(*light, facts)));
    const auto zeros = distributionOf(*import(IesText{.values = "5 -0 7"}.text()));
    EXPECT_TRUE(import <TbtFormat>(written<TbtFormat>(*zeros)));
    EXPECT_EQ(log.take(), "");
}

TEST_F(Faithful, LabelsAndNumbersTravelWithTheLight) {
    const IesText source{.header = "IESNA:LM-63-2002\n[TEST] 77\n[MANUFAC] Alder\n[LUMCAT] 5\nplain\n[LAMP] " +
                                   std::string(72, 'x') + "yz\n"};
    const auto web = import(source.text(), L"lantern");
    const auto dist = distributionOf(*web);
    // A type that the web does not tell stays.
    const IesText sided{.type = 2, .vertical = {-60, 0, 60}, .horizontal = {0, 45}};
    const auto sidedDist = distributionOf(*import(sided.text()));
    const FileFacts sidedFacts = describe(immortal<IESBuilder>(), sided.text());
    EXPECT_EQ(
        *describe(immortal<IESBuilder>(), written<IesFormat>(*sidedDist, sidedFacts)).find(L"photometricType"),
        L"B");
    EXPECT_EQ(*describe(immortal<IESBuilder>(), written<IesFormat>(*sidedDist)).find(L"photometricType"), L"A");

    const FileFacts facts = describe(immortal<IESBuilder>(), source.text());
    const std::string ies = written<IesFormat>(*dist, facts);
    EXPECT_TRUE(
        ies.starts_with("IESNA:LM-63-2002\n[TEST] 77\n[MANUFAC] Alder\n[LUMCAT] 5\n[OTHER] plain\n[LAMP] " +
                        std::string(72, 'x') + "y\n[MORE] z\n[LUMINAIRE] lantern\nTILT=NONE\n"))
        << ies;
    const FileFacts cibse = describe(immortal<CIBSEBuilder>(), written<CibseFormat>(*dist, facts));
    EXPECT_EQ(*cibse.find(L"label 1"), L"lantern");
    EXPECT_EQ(*cibse.find(L"label 3"), L"[MANUFAC] Alder");
    const FileFacts nimb = describe(immortal<NIMBBuilder>(), written<NimbFormat>(*dist, facts));
    EXPECT_EQ(*nimb.find(L"line 2"), L"Alder");
    EXPECT_EQ(*nimb.find(L"line 3"), L"lantern");
    EXPECT_TRUE(written<TbtFormat>(*dist, facts).starts_with("lantern\n3\n"));
    FileFacts other;  // what fills its line is not continued, and every control character is a blank
    other.add(L"LAMP", std::wstring(73, L'y'), FactKind::keyword);
    other.add(L"line", L"a\x1f\x20\x21\x7fz", FactKind::label);
    EXPECT_NE(written<IesFormat>(*dist, other).find("y\n[OTHER] a  ! z\n[LUMINAIRE]"), std::string::npos);
    // And back: the keywords are known again.
    EXPECT_NE(written<IesFormat>(*dist, cibse).find("\n[MANUFAC] Alder\n"), std::string::npos);
}

TEST_F(Faithful, LabelsKeepTheirTextAndTheirBytes) {
    const std::wstring utf8 = L"UTF-8", windows = L"Windows-1252";
    std::string umlauts;
    for (int i = 0; i < 45; ++i) umlauts += "\xc3\xbc";
    const struct {
        std::string bytes;
        std::wstring text, encoding;
    } cases[] = {
        {"plain", L"plain", L""},
        {"M\xc3\xbcller", L"M\u00fcller", utf8},
        {"M\xfcller", L"M\u00fcller", windows},
        {"\x80\x81 \x93q\x94 \x9f", L"\u20ac\x81 \u201cq\u201d \u0178", windows},
        {"\xc3\xbc \xfc", L"\u00c3\u00bc \u00fc", windows},
        {"\xe7\x81\xaf", L"\u706f", utf8},
        {"a\xc3", L"a\u00c3", windows},
        {"\xed\xa0\xbe", L"\u00ed\u00a0\u00be", windows},
        {"x" + umlauts, L"x" + std::wstring(45, L'\u00fc'), utf8},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.bytes);
        const IesText source{.header = "IESNA91\n[LUMINAIRE] " + c.bytes + "\n[TEST] \x20\n"};
        const auto web = import(source.text());
        const auto dist = distributionOf(*web);
        const FileFacts facts = describe(immortal<IESBuilder>(), source.text());
        ASSERT_EQ(*facts.find(L"LUMINAIRE"), c.text);
        ASSERT_EQ(c.encoding.empty() ? L"" : *facts.find(L"encoding"), c.encoding);
        const auto keeps = [&](Ov::RnPhotoFormat& format, const std::string& file, const wchar_t* key,
                               std::size_t limit) {
            const FileFacts again = describe(format, file);
            const std::wstring* text = again.find(key);
            ASSERT_TRUE(text) << file;
            EXPECT_TRUE((L"[LUMINAIRE] " + c.text).find(*text) != text->npos) << file;
            EXPECT_TRUE(c.bytes.size() > limit || file.find(c.bytes) != file.npos) << file;
            EXPECT_GE(text->size(), std::min<std::size_t>(c.text.size(), limit / 2 - 1)) << file;
            EXPECT_EQ(c.encoding.empty() ? L"" : *again.find(L"encoding"), c.encoding);
        };
        keeps(immortal<IESBuilder>(), written<IesFormat>(*dist, facts), L"LUMINAIRE", 68);
        keeps(immortal<CIBSEBuilder>(), written<CibseFormat>(*dist, facts), L"label 1", 48);
        keeps(immortal<NIMBBuilder>(), written<NimbFormat>(*dist, facts), L"line 3", 72);
        keeps(immortal<TBTBuilder>(), written<TbtFormat>(*dist, facts), L"title", 80);
    }
    // What only looks like UTF-8 in Windows-1252 is written as UTF-8; a character that the reader cut is left out.
    FileFacts facts;
    facts.add(L"title", L"\u00c3\u00bc", FactKind::label);
    facts.add(L"encoding", windows, FactKind::ofLight);
    const auto light = Ov::rnCreate<Isotropic>();
    light->setPeakIntensity(80);
    EXPECT_TRUE(written<TbtFormat>(*light, facts).starts_with("\xc3\x83\xc2\xbc\n"));
    std::string nimb = written<NimbFormat>(*light);
    nimb.replace(nimb.find("Measurement unknown"), 19, std::string(35, '-') + umlauts.substr(0, 40));
    EXPECT_EQ(*describe(immortal<NIMBBuilder>(), nimb).find(L"line 1"),
              std::wstring(35, L'-') + std::wstring(18, L'\u00fc'));
}

TEST_F(Faithful, NoTextMakesAFileLookLikeOneOfAnotherFormat) {
    const auto light = Ov::rnCreate<Isotropic>();
    light->setPeakIntensity(80);
    const std::wstring fine = L"TILT as it may stand",
                       column = std::wstring(36, L'x') + L"NIMB" + std::wstring(32, L'x');
    for (const std::wstring& text :
         {std::wstring(L"IESNA91"), std::wstring(L"CIBSE/1"), std::wstring(L"TILT=NONE"), column}) {
        FileFacts facts;
        for (const wchar_t* key : {L"title", L"label 1", L"label 2", L"line 1", L"line 3", L"TEST"})
            facts.add(key, text, key == std::wstring(L"TEST") ? FactKind::keyword : FactKind::label);
        facts.add(L"line 2", fine, FactKind::label);
        const auto takenFor = [](const std::string& file) {
            return builderTable().find(recognisedClass(*Ov::rnCreate<Ov::RnMemoryBuffer>(file)));
        };
        const std::string narrow(text.begin(), text.end());
        const auto told = [&](int times) {
            std::string messages;
            for (int i = 0; i < times; ++i) messages += (i > 0 ? "; 13082 " : "13082 ") + narrow;
            return messages;
        };
        EXPECT_EQ(takenFor(written<IesFormat>(*light, facts)), &immortal<IESBuilder>());
        EXPECT_EQ(takenFor(written<CibseFormat>(*light, facts)), &immortal<CIBSEBuilder>());
        EXPECT_EQ(log.take(), "");
        const std::string nimb = written<NimbFormat>(*light, facts);
        EXPECT_EQ(takenFor(nimb), &immortal<NIMBBuilder>());
        const bool tilt = text.starts_with(L"TILT=");
        const std::string blank = tilt ? " " : "";
        EXPECT_NE(nimb.find("\n" + blank + narrow + "\nTILT as it may stand\n" + blank + narrow + "\n"), nimb.npos)
            << nimb;
        EXPECT_EQ(log.take(), told(tilt ? 2 : 0));
        const std::string tbt = written<TbtFormat>(*light, facts);
        EXPECT_EQ(takenFor(tbt), &immortal<TBTBuilder>());
        EXPECT_TRUE(tbt.starts_with(" " + narrow + "\n")) << tbt;
        EXPECT_EQ(log.take(), told(1));
    }
}

/// Saves scenes, with the setting of the module as it is wanted.
class SavedLight : public Photo {
protected:
    ~SavedLight() override { form->setFaithful(false); }

    /// A distribution, saved as a whole object and loaded; null when saving is refused.
    RnRef<Ov::RnWebIntensityDist> again(Ov::RnCastable& dist, Form streamForm) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        try {
            Ov::RnStream(io.get(), streamForm) << &dist;
        } catch (const Ov::RnStreamEx::ExWriteError&) {
            return {};
        }
        io->seek(0, 0);
        Ov::RnStream stream(io.get(), streamForm);
        return Ov::rnQuery<Ov::RnWebIntensityDist>(stream.readObject(nullptr).get());
    }

    /// The largest difference of two lights over the sphere in the host frame, of the peak.
    static double difference(const Ov::RnWebIntensityDist& a, const Ov::RnWebIntensityDist& b) {
        double worst = 0;
        for (double theta = 0; theta <= 180; theta += 0.9)
            for (double psi = 0; psi < 360; psi += 4.7) {
                const auto d = direction(theta, psi);
                worst = std::max(worst, std::fabs(double(a.intensityAt(d)) - b.intensityAt(d)));
            }
        return worst > 0 ? worst / a.getPeakIntensity() : 0;
    }

    static std::vector<double> anglesOf(const Ov::RnPhotoWebData& web) {
        std::vector<double> angles;
        for (int i = 0; i < web.getThetaCount(); ++i) angles.push_back(web.getTheta(i));
        for (int j = 0; j < web.getPsiCount(); ++j) angles.push_back(web.getPsi(j));
        return angles;
    }

    RnRef<Ov::RnWebSaveForm> form =
        Ov::rnQuery<Ov::RnWebSaveForm>(static_cast<Ov::RnComponentBuilder*>(&immortal<WebBuilder>()));
};

TEST_F(SavedLight, AFaithfulSceneGivesTheSameLightWhenItIsLoaded) {
    const std::vector<double> up{0, 22.5, 45.13, 61.876543, 90};
    const std::vector<double> across{-90, -22.37, 0, 12.3456789, 90};
    const auto ies = [&](const IesText& text) -> RnRef<Ov::RnPhotoWebData> { return import(text.text()); };
    const auto cibse = [&](int type, const std::vector<double>& vertical, const std::vector<double>& horizontal) {
        return RnRef<Ov::RnPhotoWebData>(import <CibseFormat>(cibseText(type, vertical, horizontal)));
    };
    const struct {
        const char* what;
        RnRef<Ov::RnPhotoWebData> web;
        bool lostAsSaved = false;  // what the form loses that is the default: a tenth of the peak, or little
    } cases[] = {
        {"one plane", ies({.vertical = up, .values = "1000.3 500.2 7 1 0"})},
        {"a quarter", ies({.vertical = up, .horizontal = {0, 45, 90}})},
        {"a wall-washer", ies({.vertical = up, .horizontal = {90, 180, 270}}), true},
        {"planes to 210", ies({.vertical = up, .horizontal = {0, 90, 210}})},
        {"type A",
         ies({.type = 3, .vertical = across, .horizontal = {-23.4642376, 13, 26.395, 48.9110269, 87.8973593}}),
         true},
        {"type A, one side", ies({.type = 3, .vertical = {-90, 0, 30}, .horizontal = {0, 60}})},
        {"type B", ies({.type = 2, .vertical = across, .horizontal = {-45.678901, 0, 77.7}}), true},
        {"type B, one side", ies({.type = 2, .vertical = across, .horizontal = {0, 45, 90}}), true},
        {"no lumens", ies({.lumens = -1, .vertical = up})},
        {"weak", ies({.lumens = 0.003, .vertical = up, .values = "0.02 0.0123 0.004 0.001 0"})},
        {"a flux below 0", ies({.lumens = -1, .vertical = up, .values = "10 -30 -30 -30 -30"})},
        {"dark", ies({.vertical = up, .values = "0 0 0 -1 0"})},
        {"type 1", cibse(1, up, {0, 45, 90})},
        {"type 1 from 90", cibse(1, up, {90, 180, 270}), true},
        {"type 1 from 270", cibse(1, up, {270, 0, 90}), true},
        {"type 1 once around", cibse(1, {0, 45, 180}, {270, 0, 90, 180, 270}), true},
        {"type 2", cibse(2, across, {-30.3, 0, 60.5}), true},
        {"type 2, one side", cibse(2, {-90, 0, 90}, {0, 45, 90}), true},
    };
    for (const auto& [what, web, lostAsSaved] : cases) {
        SCOPED_TRACE(what);
        ASSERT_TRUE(web) << log.take();
        const float peak = web->getMaxCandela();
        for (const float factor : {1.0f, 0.31f})
            for (const Form streamForm : {Form::text, Form::binary}) {
                const auto dist = distributionOf(*web);
                factor == 1 ? dist->setPeakIntensity(peak) : dist->setFlux(factor * web->getLumens());
                form->setFaithful(true);
                const auto loaded = again(*dist, streamForm);
                ASSERT_TRUE(loaded) << log.take();
                EXPECT_LT(difference(*dist, *loaded), 1e-5);
                EXPECT_LT(difference(*dist, *again(*loaded, streamForm)), 1e-5) << "saved twice";
                EXPECT_NEAR(loaded->getFlux(), dist->getFlux(), 1e-5 * std::fabs(dist->getFlux()));
                const auto loadedWeb = webOf(*loaded);
                EXPECT_NEAR(loadedWeb->getMaxCandela(), peak, 1e-5 * peak);
                EXPECT_NEAR(loadedWeb->getLumens(), web->getLumens(), 1e-5 * std::fabs(web->getLumens()));
                EXPECT_EQ(anglesOf(*loadedWeb), anglesOf(*web));
                form->setFaithful(false);
                EXPECT_EQ(difference(*dist, *again(*dist, streamForm)) > 0.1, lostAsSaved);
            }
    }
    EXPECT_EQ(log.take(), "");
}

TEST_F(SavedLight, WhatAFormatCannotHoldIsToldAndOtherFormatsAreSavedAsTheyAre) {
    // The reader takes 90.2 for being close to 90.
    const auto beyond =
        import(IesText{.type = 3, .vertical = {-90, 90}, .horizontal = {-90, 0, 90.2}}.text(), L"x");
    const auto nimb = import <NimbFormat>("   1   0  90  90  45  90   0   0   0NIMB\n\n\n\n\n 100  90  10\n");
    const auto tbt = import <TbtFormat>(tbtCircle(5, 5));
    ASSERT_TRUE(beyond && nimb && tbt) << log.take();
    const auto bytes = [](Ov::RnCastable& object) {
        return std::pair(saved(object), saved(object, Form::binary));
    };
    const auto before = bytes(*beyond);
    const auto nimbBefore = bytes(*nimb);
    const auto tbtBefore = bytes(*tbt);
    EXPECT_FALSE(form->isFaithful());
    form->setFaithful(true);
    EXPECT_TRUE(form->isFaithful());
    EXPECT_THROW(saved(*beyond), Ov::RnStreamEx::ExWriteError);
    EXPECT_EQ(log.take(), "13083 x");
    EXPECT_EQ(bytes(*nimb), nimbBefore);
    EXPECT_EQ(bytes(*tbt), tbtBefore);
    form->setFaithful(false);
    EXPECT_EQ(bytes(*beyond), before);
}

}  // namespace
}  // namespace OvPhotometrics
