#include <gmock/gmock.h>

#include "components/photo/distributions/diffuse.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/ies/photoWebIES.h"
#include "plot/axis.h"
#include "plot/caption.h"
#include "plot/curve.h"
#include "plot/isolines.h"
#include "plot/picture.h"
#include "plot/solid.h"
#include "tests/photo/photoFixture.h"
#include "tests/plot/svgPath.h"

// The geometry of what is drawn, not its pixels.

using namespace OvPlot;
using OvPhotometrics::IesText;
using testing::ElementsAre;

namespace {

template <class Dist>
Ov::RnRef<Dist> lamp(float candela) {
    const auto light = Ov::rnCreate<Dist>();
    light->setPeakIntensity(candela);
    return light;
}

Subject subjectOf(const Ov::RnIntensityDist& light) { return {&light, {}, "lamp", {}, {}}; }

class PlotCurves : public OvPhotometrics::Photo {
protected:
    /// The light of a type C file.
    Ov::RnRef<Ov::RnWebIntensityDist> lightOf(const IesText& file) {
        const auto web = import(file.text());
        EXPECT_TRUE(web) << log.take();
        const auto light = distributionOf(*web);
        light->setPeakIntensity(web->getMaxCandela());
        return light;
    }
};

TEST_F(PlotCurves, AnIsotropicLightIsACircleAndADiffuseOneACircleThroughTheOrigin) {
    const auto even = lamp<OvPhotometrics::Isotropic>(50);
    const Path around = polarPath(PlaneCurve(subjectOf(*even), 0), 2);
    EXPECT_GT(around.size(), 360U);
    for (const Point& point : around) EXPECT_NEAR(distance(point, {}), 100, 1e-9);

    const auto lambert = lamp<OvPhotometrics::Diffuse>(50);
    std::size_t behind = 0;
    for (const Point& point : polarPath(PlaneCurve(subjectOf(*lambert), 30), 2)) {
        if (distance(point, {}) < 1e-4) {
            ++behind;
        } else {
            EXPECT_NEAR(distance(point, {0, 50}), 50, 1e-4);  // gamma 0 is at the bottom
        }
    }
    EXPECT_NEAR(static_cast<double>(behind) / static_cast<double>(around.size()), 0.5, 0.01);
}

TEST_F(PlotCurves, HalvesAreShownInFullAndBetweenSamplesTheDistributionIsAsked) {
    const auto light = lightOf({.horizontal = {0, 45, 90, 135, 180}});  // i + 10 j + 1 candela
    const Subject subject = subjectOf(*light);
    const PlaneCurve across(subject, 90), along(subject, 0), right(subject, 30), left(subject, 330);
    for (std::size_t i = 0; i < across.size(); ++i) {
        const std::size_t mirrored = across.size() - 1 - i;
        EXPECT_NEAR(across.value(i), across.value(mirrored), 1e-5) << across.angle(i);
        // C 30 and 330 are one by symmetry; so are 210 and 150.
        EXPECT_NEAR(right.value(i), left.value(i), 1e-5) << right.angle(i);
        const float theta = static_cast<float>(radians(std::abs(along.angle(i))));
        const float psi = along.angle(i) < 0 ? 3.1415927F : 0.0F;
        EXPECT_NEAR(along.value(i), light->localIntensity(theta, psi), 1e-5);
    }
    EXPECT_EQ(along.largest(), 43);
}

TEST_F(PlotCurves, TheSolidIsAsFarAsItIsBright) {
    const auto light = lightOf({.horizontal = {0, 90, 180, 270}});
    const Subject subject = subjectOf(*light);
    const SolidMesh mesh = solidMesh(subject, 20, 36);
    EXPECT_EQ(mesh.gammas.front(), 0);
    EXPECT_EQ(mesh.gammas.back(), 180);
    EXPECT_EQ(mesh.radii.size(), mesh.gammas.size() * mesh.planes);
    EXPECT_EQ(*std::max_element(mesh.radii.begin(), mesh.radii.end()), 1);
    for (const std::size_t plane : {0U, 7U, 35U}) {
        const double intensity = subject.intensity(mesh.gammas[3], 10.0 * static_cast<double>(plane));
        EXPECT_NEAR(mesh.radius(plane, 3) * mesh.peak, intensity, 1e-6);
    }
    const auto dark = lamp<OvPhotometrics::Isotropic>(0);
    EXPECT_EQ(solidMesh(subjectOf(*dark), 20, 36).peak, 0);
}

TEST(PlotAxis, TicksAreRoundAndFewAndCoverTheRange) {
    for (double maximum = 1e-6; maximum < 1e12; maximum *= 1.37) {
        const Axis axis = axisTo(maximum, 5);
        EXPECT_GE(axis.last, maximum * (1 - 1e-9));
        EXPECT_LE(axis.ticks().size(), 6U);
        EXPECT_GE(axis.ticks().size(), 3U) << maximum;
        const double mantissa = axis.step / std::pow(10, std::floor(std::log10(axis.step) + 1e-9));
        EXPECT_THAT(mantissa, testing::AnyOf(testing::DoubleNear(1, 1e-9), testing::DoubleNear(2, 1e-9),
                                             testing::DoubleNear(2.5, 1e-9), testing::DoubleNear(5, 1e-9)));
    }
    EXPECT_THAT(axisTo(2150, 5).ticks(), ElementsAre(0, 500, 1000, 1500, 2000, 2500));
    for (const double none : {0.0, -1.0, std::nan(""), HUGE_VAL}) EXPECT_EQ(axisTo(none, 5).last, 1);
    EXPECT_THAT(degreeAxis(-90, 90, 12).ticks(), testing::Contains(-75));
    EXPECT_EQ(degreeAxis(-180, 180, 12).step, 30);
    EXPECT_THAT(roundLevels(238, 5), ElementsAre(200, 100, 50, 20, 10));
    EXPECT_THAT(roundLevels(0, 5), ElementsAre());
    EXPECT_EQ(tickLabel(axisTo(0.3, 3).ticks()[3]), "0.3");
}

TEST(PlotIsolines, AConeHasCirclesAndAPlaneLinesFromRimToRim) {
    Grid cone{41, 41, {}}, plane{5, 4, {}}, saddle{2, 2, {1, 0, 0, 1}};
    for (int row = 0; row < 41; ++row)
        for (int column = 0; column < 41; ++column) cone.values.push_back(std::hypot(column - 20.0, row - 20.0));
    for (int row = 0; row < 4; ++row)
        for (int column = 0; column < 5; ++column) plane.values.push_back(column);
    const auto circles = isolines(cone, 12.3);
    ASSERT_EQ(circles.size(), 1U);
    EXPECT_EQ(distance(circles[0].front(), circles[0].back()), 0);
    EXPECT_GT(circles[0].size(), 60U);
    for (const Point& point : circles[0]) EXPECT_NEAR(distance(point, {20, 20}), 12.3, 0.02);
    const auto lines = isolines(plane, 1.5);
    ASSERT_EQ(lines.size(), 1U);
    EXPECT_EQ(lines[0].size(), 4U);
    for (const Point& point : lines[0]) EXPECT_EQ(point.x, 1.5);
    EXPECT_EQ(isolines(saddle, 0.4).size(), 2U);
    EXPECT_TRUE(isolines(plane, 9).empty());
}

TEST(PlotGeometry, ASimplerPathStaysNearThePath) {
    Path wave;
    for (int i = 0; i <= 1000; ++i) wave.push_back({i * 0.5, 40 * std::sin(i * 0.02)});
    const Path few = simplified(wave, 0.1);
    EXPECT_LT(few.size(), 150U);
    EXPECT_EQ(distance(few.front(), wave.front()) + distance(few.back(), wave.back()), 0);
    std::size_t at = 1;
    for (const Point& point : wave) {
        while (few[at].x < point.x) ++at;
        const double share = (point.x - few[at - 1].x) / (few[at].x - few[at - 1].x);
        EXPECT_NEAR(few[at - 1].y + share * (few[at].y - few[at - 1].y), point.y, 0.25);
    }
}

TEST(PlotPicture, HasTheSizeAndTheFormatThatWereAskedFor) {
    const auto light = lamp<OvPhotometrics::Isotropic>(50);
    Diagram diagram;
    diagram.subjects = {subjectOf(*light)};
    diagram.planes = {0};
    const auto drawn = [&](PictureFormat format) {
        return drawPicture(format, {900, 750}, darkPalette(), "</title><script>&\x01\xff",
                           [&](Canvas& canvas) { drawPolar(canvas, diagram); });
    };
    const std::string png = drawn(PictureFormat::png);
    EXPECT_EQ(png.substr(1, 3), "PNG");
    EXPECT_EQ(png.substr(16, 8), std::string("\0\0\3\204\0\0\2\356", 8));
    const std::string pdf = drawn(PictureFormat::pdf);
    EXPECT_EQ(pdf.substr(0, 5), "%PDF-");
    const std::string svg = drawn(PictureFormat::svg);
    EXPECT_THAT(svg, testing::HasSubstr("viewBox=\"0 0 900 750\""));
    EXPECT_THAT(svg, testing::HasSubstr("<title>&lt;/title&gt;&lt;script&gt;&amp; \uFFFD</title>"));
    EXPECT_EQ(svg.find("<script"), std::string::npos);
    // A ring of 50 candela: all points as far from their middle.
    const Path circle = longestPath(svg);
    ASSERT_GT(circle.size(), 30U);
    const Box box = extentOf(circle);
    for (const Point& p : circle) EXPECT_NEAR(distance(p, box.centre()), box.width() / 2, 0.1);
}

TEST(PlotPicture, LongTitlesTakeLinesThatFit) {
    drawPicture(PictureFormat::svg, {}, lightPalette(), "", [](Canvas& canvas) {
        const Font font = canvas.font();
        const std::string words = "one two three four five six seven eight nine ten";
        const double width = canvas.textWidth("one two three four", font);
        const auto lines = canvas.wrapped(words, font, width, 9);
        EXPECT_GT(lines.size(), 2U);
        std::string joined;
        for (const std::string& line : lines) {
            EXPECT_LE(canvas.textWidth(line, font), width) << line;
            joined += (joined.empty() ? "" : " ") + line;
        }
        EXPECT_EQ(joined, words);
        EXPECT_THAT(canvas.wrapped(words, font, width, 2),
                    ElementsAre("one two three four", testing::EndsWith("\u2026")));
        EXPECT_EQ(canvas.wrapped(std::string(60, 'm'), font, width, 9).size(),
                  std::ceil(60 / std::floor(width / canvas.textWidth("m", font))));
        EXPECT_THAT(canvas.wrapped("", font, width, 3), ElementsAre(""));
        const std::string longTitle(90, 'm');
        EXPECT_GT(drawCaption(canvas, longTitle, "", {}).top, drawCaption(canvas, "m", "", {}).top + 20);
        EXPECT_GT(drawCaption(canvas, "", longTitle, {}).top, drawCaption(canvas, "", "m", {}).top + 15);
    });
}

TEST(PlotPicture, EveryDiagramIsDrawnOfDarkAndOfBrightestLights) {
    for (const float candela : {0.0F, 1e-30F, 3e38F}) {
        const auto light = lamp<OvPhotometrics::Isotropic>(candela);
        Diagram diagram;
        diagram.subjects = {subjectOf(*light)};
        for (const auto draw : {drawPolar, drawCartesian, drawCone, drawIsolux, drawSolid}) {
            const std::string svg = drawPicture(PictureFormat::svg, {600, 600}, lightPalette(), "",
                                                [&](Canvas& canvas) { draw(canvas, diagram); });
            EXPECT_EQ(svg.find("nan"), std::string::npos) << candela;
            EXPECT_EQ(svg.find("inf"), std::string::npos) << candela;
        }
    }
}

}  // namespace
