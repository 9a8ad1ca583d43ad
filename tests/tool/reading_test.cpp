#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <regex>

#include "tool/toolRun.h"

namespace {

using Json = nlohmann::ordered_json;

const std::string examples = OVPHOTO_SOURCE_DIR "/examples/";

/// The first of the printed objects; an empty one after a failure.
Json one(const ToolResult& result) {
    EXPECT_EQ(result.status, 0) << result.err;
    const auto objects = result.json();
    EXPECT_FALSE(objects.empty());
    return objects.empty() ? Json::object() : objects.front();
}

TEST(ToolFormats, ListsTheBuildersAndTellsAFilesFormat) {
    TempFolder folder;
    folder.write("letter.txt", "Dear reader,\n");
    folder.write("old.ies", "A maker's file\nof 1986\nTILT=NONE\n");
    bool found = false;
    for (const Json& builder : runTool("formats --json", folder).json()) {
        if (builder["name"] != "IES Web") continue;
        found = true;
        EXPECT_EQ(builder["classId"], "3debfa00 e42611d1 aaab6e3d f2000000");
        EXPECT_EQ(builder["category"], "Photometric Web");
        EXPECT_EQ(builder["extension"], "ies");
        EXPECT_EQ(builder["creatable"], true);
    }
    EXPECT_TRUE(found);
    const Json old = one(runTool("formats --detect old.ies --json", folder));
    EXPECT_EQ(old["format"], "IES");
    EXPECT_EQ(old["canImport"]["IES"], true);
    const Json letter = one(runTool("formats --detect letter.txt --json", folder));
    EXPECT_TRUE(letter["format"].is_null());
    EXPECT_EQ(letter["canImport"]["IES"], false);
    EXPECT_EQ(runTool("formats --detect none.txt", folder).status, 1);
}

TEST(ToolInfo, TellsTheWebInJson) {
    IesFile file;
    file.verticals = {0, 0.1, 33.3, 90};
    file.horizontals = {90, 180, 270};
    file.candela = [](double v, double h) { return v + h; };
    TempFolder folder;
    folder.write("a \xC3\xA4 \xFF.ies", file.text());
    const Json info = one(runTool("info --json --values *.ies", folder));

    const char* keys[] = {"file",        "format",       "name",
                          "symmetry",    "thetas",       "psis",
                          "maxCandela",  "lumens",       "identityOrientation",
                          "orientation", "psiTruncated", "files",
                          "values"};
    std::size_t k = 0;
    for (const auto& item : info.items()) EXPECT_EQ(item.key(), keys[k++]);
    EXPECT_EQ(info["name"], "a \xC3\xA4 \xEF\xBF\xBD");  // the odd byte became U+FFFD
    EXPECT_EQ(info["symmetry"], "Half");
    EXPECT_EQ(info["thetas"].dump(), "[0.0,0.1,33.3,90.0]");
    EXPECT_EQ(info["psis"].dump(), "[0.0,90.0,180.0]");
    EXPECT_EQ(info["maxCandela"], 360);
    EXPECT_EQ(info["identityOrientation"], false);
    EXPECT_EQ(info["psiTruncated"], false);
    for (std::size_t j = 0; j < 3; ++j) {
        for (std::size_t i = 0; i < 4; ++i) {
            const float value = static_cast<float>(file.candela(file.verticals[i], file.horizontals[j])) / 360.0F;
            EXPECT_EQ(info["values"][j][i].get<float>(), value) << j << " " << i;
        }
    }
}

TEST(ToolInfo, ARefusedFileStopsNothingAndHasItsLine) {
    TempFolder folder;
    IesFile bad;
    bad.horizontals = {0, 45};
    folder.write("bad.ies", bad.text());
    const ToolResult result = runTool("info --json bad.ies none.ies " + examples + "downlight.ies", folder);
    EXPECT_EQ(result.status, 1);
    const auto objects = result.json();
    ASSERT_EQ(objects.size(), 3U);
    EXPECT_NE(objects[0]["error"].get<std::string>().find("45"), std::string::npos);
    EXPECT_EQ(objects[1]["file"], "none.ies");
    EXPECT_EQ(objects[2]["symmetry"], "Axial");
    EXPECT_EQ(result.err.find("bad.ies: "), 0U);
}

/// The two angles that `info` prints for a plane.
std::pair<double, double> printedAngles(const ToolResult& result, const std::string& plane) {
    const std::size_t at = result.out.find("\n  " + plane + " ");
    if (at == std::string::npos) return {};
    std::istringstream line(result.out.substr(at + plane.size() + 3));
    std::string unit;
    std::pair<double, double> angles;
    line >> angles.first >> unit >> angles.second;
    return angles;
}

TEST(ToolInfo, BeamAnglesAreThoseOfTheCurve) {
    TempFolder folder;
    IesFile cosine;  // cos^12: half at 2 acos(0.5^(1/12))
    cosine.verticals = angles(0, 90, 2.5);
    cosine.candela = [](double v, double) { return 1000 * std::pow(std::cos(v * std::numbers::pi / 180), 12); };
    folder.write("cosine.ies", cosine.text());
    const auto width = [](double level) {
        return 2 * std::acos(std::pow(level, 1 / 12.0)) * 180 / std::numbers::pi;
    };
    for (const char* plane : {"C0-C180", "C90-C270"}) {
        const auto [beam, field] = printedAngles(runTool("info cosine.ies", folder), plane);
        EXPECT_NEAR(beam, width(0.5), 0.15) << plane;
        EXPECT_NEAR(field, width(0.1), 0.15) << plane;
    }

    // Types A and B: through the axis, which lies where the angles are 0, and not in the middle of the planes.
    IesFile flood;
    flood.verticals = angles(-60, 60, 5);
    flood.horizontals = angles(-80, 50, 5);
    flood.candela = [](double v, double h) { return 5000 * std::exp2(-v * v / 100 - h * h / 400); };
    for (int type : {2, 3}) {
        flood.type = type;
        folder.write("flood.ies", flood.text());
        const ToolResult info = runTool("info flood.ies", folder);
        EXPECT_NEAR(printedAngles(info, "horizontal").first, 40, 0.3) << type << info.out;
        EXPECT_NEAR(printedAngles(info, "vertical").first, 20, 0.3) << type << info.out;
    }
    folder.write("even.ies", IesFile{.verticals = {0, 90, 180}}.text());
    const std::string even = runTool("info even.ies", folder).out;  // never falls: no angles
    EXPECT_TRUE(std::regex_search(even, std::regex("\n  C0-C180 +- +-\n"))) << even;
}

TEST(ToolInfo, PlanesOfA90To270FileAreThoseOfTheSameLightWrittenOut) {
    IesFile half;
    half.verticals = angles(0, 90, 5);
    half.horizontals = angles(90, 270, 15);
    half.candela = [](double v, double h) {
        const double s = std::sin(h * std::numbers::pi / 180);
        return 1000 * std::exp(-v * v / (800 + 500 * s + 200 * s * s));
    };
    IesFile full = half;
    full.horizontals = angles(0, 360, 15);
    TempFolder folder;
    folder.write("half.ies", half.text());
    folder.write("full.ies", full.text());
    const ToolResult a = runTool("info half.ies", folder);
    const ToolResult b = runTool("info full.ies", folder);
    for (const char* plane : {"C0-C180", "C90-C270"}) {
        EXPECT_GT(printedAngles(a, plane).first, 10);
        EXPECT_NEAR(printedAngles(a, plane).first, printedAngles(b, plane).first, 0.11);
        EXPECT_NEAR(printedAngles(a, plane).second, printedAngles(b, plane).second, 0.11);
    }
}

TEST(ToolIntensity, AnswersEveryGivenDirection) {
    IesFile file;
    file.lamps = "1 1000";
    file.verticals = {0, 30, 60, 90};
    file.horizontals = {0, 90, 180, 270, 360};
    file.candela = [](double v, double h) { return 10 * v + (h == 360 ? 0 : h); };
    TempFolder folder;
    folder.write("f.ies", file.text());
    const auto candela = [&](const std::string& arguments, const std::string& input = "") {
        std::vector<double> values;
        for (const Json& line : runTool("intensity f.ies --json " + arguments, folder, input).json()) {
            values.push_back(std::round(line["candela"].get<double>() * 1000) / 1000);
        }
        return values;
    };
    const std::vector<double> expected{300, 690, 1170, 0};
    EXPECT_EQ(candela("30,0 60,90 90,270 120,0"), expected);
    EXPECT_EQ(candela("", "30,0\n  60\t90 \r\n\n# a comment\n90 , 270\n120 0"), expected);
    EXPECT_EQ(candela("30,0 --flux 500"), std::vector<double>{150});
    // Minus signs, behind "--" and without it: psi of -90 is 270, theta below 0 is 0.
    EXPECT_EQ(candela("-- -5,0 30,-90"), (std::vector<double>{0, 570}));
    EXPECT_EQ(candela("-5,0 30,-90"), (std::vector<double>{0, 570}));
    EXPECT_TRUE(runTool("intensity f.ies 60,90", folder).says("60 deg       90 deg          690 cd"));
}

TEST(ToolIntensity, ABadLineIsNamedAndTheOthersAreAnswered) {
    TempFolder folder;
    folder.write("f.ies", IesFile().text());
    const ToolResult result = runTool("intensity f.ies --json", folder, "0 0\n\nnorth\n45 0\n");
    EXPECT_EQ(result.status, 1);
    EXPECT_EQ(result.json().size(), 2U);
    EXPECT_TRUE(result.says("line 3")) << result.err;
}

TEST(ToolIntensity, TheHostFrameIsThatOfTheFilesPlanes) {
    TempFolder folder;
    IesFile washer;
    washer.verticals = angles(0, 90, 5);
    washer.horizontals = angles(90, 270, 15);
    washer.candela = [](double v, double h) { return 500 + v * (2 + std::sin(h * std::numbers::pi / 180)); };
    folder.write("w.ies", washer.text());
    const auto at = [&](const std::string& arguments) {
        return one(runTool("intensity w.ies --json " + arguments, folder))["candela"].get<double>();
    };
    EXPECT_NEAR(at("--frame host 45,90"), 500 + 45 * 3, 0.01);
    EXPECT_NEAR(at("--frame host 45,270"), 500 + 45 * 1, 0.01);
    EXPECT_EQ(at("--frame local 45,0"), at("45,0"));
    EXPECT_NEAR(at("45,0"), 500 + 45 * 3, 0.01);
}

}  // namespace
