#include <gtest/gtest.h>

#include <cmath>
#include <numbers>
#include <regex>

#include "support/paths.h"
#include "tool/toolRun.h"

using Json = nlohmann::ordered_json;

/// The first of the printed objects; an empty one after a failure.
Json one(const ToolResult& result) {
    EXPECT_EQ(result.status, 0) << result.err;
    const auto objects = result.json();
    return objects.empty() ? Json::object() : objects.front();
}

TEST(ToolFormats, ListsTheBuildersAndTellsAFilesFormat) {
    TempFolder folder;
    folder.write("letter.txt", "Dear reader,\n");
    folder.write("old.ies", "A maker's file\nof 1986\nTILT=NONE\n");
    EXPECT_TRUE(
        runTool("formats --json", folder)
            .says(R"({"name":"IES Web","category":"Photometric Web","description":"IES Photometric Web",)"
                  R"("classId":"3debfa00 e42611d1 aaab6e3d f2000000","extension":"ies","creatable":true})"));
    for (const bool isOld : {true, false}) {
        const Json found =
            one(runTool(std::string("formats --json --detect ") + (isOld ? "old.ies" : "letter.txt"), folder));
        EXPECT_EQ(found["format"], isOld ? Json("IES") : Json());
        EXPECT_EQ(found["canImport"]["IES"], isOld);
    }
    EXPECT_EQ(runTool("formats --detect none.txt", folder).status, 1);
}

TEST(ToolInfo, TellsTheWebInJson) {
    IesFile file;
    file.verticals = {0, 0.1, 33.3, 90};
    file.horizontals = {90, 180, 270};
    file.candela = [](double v, double h) { return v + h; };
    TempFolder folder;
    folder.write("a \xC3\xA4 \xFF.ies", file.text());
    Json info = one(runTool("info --json --values *.ies", folder));
    for (std::size_t i = 0; i < 12; ++i) {
        const double candela = file.candela(file.verticals[i % 4], file.horizontals[i / 4]);
        EXPECT_EQ(info["values"][i / 4][i % 4].get<float>(), static_cast<float>(candela) / 360.0F) << i;
    }
    const Json facts = info["facts"];
    EXPECT_EQ(facts.at(1).dump(), R"({"key":"TEST","value":"one"})");
    EXPECT_EQ(facts.back().dump(), R"({"key":"watts","value":"0"})");
    for (const char* key : {"file", "lumens", "luminaireLumens", "orientation", "files", "values", "facts"})
        EXPECT_EQ(info.erase(key), 1U) << key;
    EXPECT_EQ(info.dump(),
              "{\"format\":\"IES\",\"name\":\"a \u00E4 \uFFFD\","  // the odd byte became U+FFFD
              R"("symmetry":"Half","thetas":[0.0,0.1,33.3,90.0],"psis":[0.0,90.0,180.0],)"
              R"("verticals":[0.0,0.1,33.3,90.0],"horizontals":[90.0,180.0,270.0],"maxCandela":360.0,)"
              R"("lampLumens":null,"outputRatio":null,"identityOrientation":false,"psiTruncated":false,)"
              R"("unit":"cd","fileUnit":"cd"})");
}

/// The two angles that `info` prints for a plane.
std::pair<double, double> printedAngles(const ToolResult& result, const std::string& plane) {
    std::smatch found;
    if (!std::regex_search(result.out, found, std::regex("\n  " + plane + " +([0-9.]+) deg +([0-9.]+) deg")))
        return {};
    return {std::stod(found[1]), std::stod(found[2])};
}

TEST(ToolInfo, BeamAnglesAreThoseOfTheCurve) {
    TempFolder folder;
    IesFile cosine;  // cos^12: half at 2 acos(0.5^(1/12))
    cosine.verticals = angles(0, 90, 2.5);
    cosine.candela = [](double v, double) { return 1000 * std::pow(std::cos(v * std::numbers::pi / 180), 12); };
    folder.write("cosine.ies", cosine.text());
    for (const char* plane : {"C0-C180", "C90-C270"}) {
        const auto [beam, field] = printedAngles(runTool("info cosine.ies", folder), plane);
        EXPECT_NEAR(beam, 360 / std::numbers::pi * std::acos(std::pow(0.5, 1 / 12.0)), 0.15) << plane;
        EXPECT_NEAR(field, 360 / std::numbers::pi * std::acos(std::pow(0.1, 1 / 12.0)), 0.15) << plane;
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
    folder.write("even.ies", IesFile{.verticals = {0, 90, 180}}.text());  // never falls: no angles
    const std::string even = runTool("info even.ies", folder).out;
    EXPECT_TRUE(std::regex_search(even, std::regex("\n  C0-C180 +- +-\n"))) << even;
}

TEST(ToolIntensity, AnglesAreThoseOfTheFileEverywhere) {
    const auto grid = [](const std::vector<double>& verticals, const std::vector<double>& horizontals) {
        std::string text;
        for (const auto* list : {&verticals, &horizontals})
            for (const double angle : *list) text += std::to_string(angle) + "\n";
        for (std::size_t j = 0; j < horizontals.size(); ++j)
            for (std::size_t i = 0; i < verticals.size(); ++i)
                text += std::to_string(std::fmod(horizontals[j] - horizontals[0], 360) == 0 ? 10 + i
                                                                                            : 10 + i + 5 * j) +
                        "\n";
        return text;
    };
    using Angles = std::vector<double>;
    const struct {
        int format;  // 0: IES, 1: CIBSE
        int type;
        Angles verticals, horizontals;
    } cases[] = {
        {0, 1, {0, 30, 90}, {90, 135.5, 180, 270}},
        {0, 1, {90, 120, 180}, {0, 90, 180, 270, 360}},
        {0, 3, {-70.3, 0, 70}, {-40.7, 0, 20.1}},
        {0, 3, {-90, 0, 90}, {0, 30, 60}},
        {0, 2, {-45, 0, 60}, {-30, 0, 80}},
        {0, 2, {-45, 0, 60}, {0, 30, 80}},
        {1, 1, {0, 45, 90}, {270, 300, 0, 90}},
        {1, 1, {0, 90, 180}, {270, 0, 90, 180, 270}},
        {1, 1, {0, 90, 180}, {90, 180, 270}},
        {1, 1, {0, 90, 180}, {270, 330, 0, 30, 90}},
        {1, 1, {0, 90, 180}, {270, 0, 90, 180, 269}},
        {1, 2, {-90, 0, 90}, {-30, 0, 60.5}},
        {1, 2, {-90, 0, 90}, {0, 45, 90}},
    };
    TempFolder folder;
    for (const auto& c : cases) {
        const std::string counts =
            std::to_string(c.verticals.size()) + " " + std::to_string(c.horizontals.size()) + "\n";
        const std::string body = grid(c.verticals, c.horizontals);
        const std::string type = std::to_string(c.type);
        folder.write("f",
                     c.format == 0
                         ? "IESNA91\nTILT=NONE\n1 -1 1 " + counts + type + " 2 0 0 0\n1 1 0\n" + body
                         : "CIBSE/1\n\n\n\n\n\n\n\n1 " + type + " 0 0 0 1 0 0 0\n" + counts + body + "99 0 0 0");
        SCOPED_TRACE(type + " of " + std::to_string(c.format) + ": " + counts + body);
        const Json info = one(runTool("info --json f", folder));
        EXPECT_EQ(info["verticals"].get<Angles>(), c.verticals);
        EXPECT_EQ(info["horizontals"].get<Angles>(), c.horizontals);
        std::string directions;
        for (const double h : c.horizontals)
            for (const double v : c.verticals) directions += std::to_string(v) + " " + std::to_string(h) + "\n";
        const auto answers = runTool("intensity --json f", folder, directions).json();
        const std::string host =
            c.type == 1 ? " --frame host" : "";  // the same for planes through a vertical axis
        const auto inHost = runTool("intensity --json f" + host, folder, directions).json();
        std::istringstream values(body);
        for (double skipped, k = 0; k < double(c.verticals.size() + c.horizontals.size()); ++k) values >> skipped;
        std::size_t best = 0;
        for (std::size_t k = 0; k < c.verticals.size() * c.horizontals.size(); ++k) {
            double value = 0;
            values >> value;
            EXPECT_NEAR(answers.at(k)["candela"].get<double>(), value, 1e-4) << answers.at(k);
            const double vertical = c.verticals[k % c.verticals.size()];
            EXPECT_NEAR(inHost.at(k)["candela"].get<double>(), value,
                        vertical == 0 || vertical == 180 ? 20 : 1e-3);
            if (answers.at(k)["candela"] > answers.at(best)["candela"]) best = k;
        }
        // The peak is told where the same angles find it, in the report as well.
        const auto angle = [&](const char* name) { return answers.at(best)[name].dump(); };
        const std::string text = runTool("info f", folder).out;
        std::smatch found;
        ASSERT_TRUE(std::regex_search(text, found, std::regex("cd at vertical (\\S+) deg, horizontal (\\S+) deg")))
            << text;
        EXPECT_EQ(std::stod(found[1]), std::stod(angle("vertical"))) << text;
        EXPECT_EQ(std::stod(found[2]), std::stod(angle("horizontal"))) << text;
    }
    // The planes that beam angles are told of are those of the file, too, whatever a NIMB file is turned by.
    const auto nimb = [&](const std::string& turn) {
        folder.write("f.nmb", "   0  90  90  90  30" + turn +
                                  "   0   0   0NIMB\nA\nB\nC\nD, a line to make it 72 bytes long, and more\n"
                                  " 100 100  90  20  50   1   0   0\n");
        return runTool("info f.nmb", folder);
    };
    for (const char* plane : {"C0-C180", "C90-C270"})
        EXPECT_EQ(printedAngles(nimb("  90"), plane), printedAngles(nimb("   0"), plane)) << plane;
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
        for (const Json& line : runTool("intensity f.ies --json " + arguments, folder, input).json())
            values.push_back(std::round(line["candela"].get<double>() * 1000) / 1000);
        return values;
    };
    using Values = std::vector<double>;
    EXPECT_EQ(candela("30,0 60,90 90,270 120,0"), (Values{300, 690, 1170, 0}));
    EXPECT_EQ(candela("", "30,0\n  60\t90 \r\n\n# a comment\n90 , 270\n120 0"), (Values{300, 690, 1170, 0}));
    EXPECT_EQ(candela("30,0 --flux 500"), Values{150});
    // Minus signs, behind "--" and without it: psi of -90 is 270.
    EXPECT_EQ(candela("-- 30,-90 0,-0"), (Values{570, 0}));
    EXPECT_EQ(candela("30,-90"), Values{570});
    // Below the axis there is nothing; where it is depends on the file.
    EXPECT_EQ(candela("", "-5,0\n60,90"), Values{690});
    for (const char* frame : {"file", "local", "host"}) {
        const ToolResult below = runTool("intensity f.ies 30,0 -5,0 --frame " + std::string(frame), folder);
        EXPECT_TRUE(below.status == 2 && below.out.empty() && below.says("-5")) << frame << below.err;
    }
    file.type = 3;
    file.verticals = {-90, 0, 90};
    file.horizontals = {-90, 0, 90};
    folder.write("a.ies", file.text());
    EXPECT_TRUE(runTool("intensity a.ies -90,0", folder).says("cd"));
    EXPECT_EQ(runTool("intensity a.ies -90.1,0", folder).status, 2);
    EXPECT_EQ(runTool("intensity a.ies -90,0 --frame local", folder).status, 2);
    EXPECT_TRUE(runTool("intensity f.ies 60,90", folder).says("60 deg       90 deg          690 cd"));

    const ToolResult bad = runTool("intensity f.ies --json", folder, "0 0\n\nnorth\n45 0\n");
    EXPECT_EQ(bad.status, 1);
    EXPECT_EQ(bad.json().size(), 2U);
    EXPECT_TRUE(bad.says("line 3")) << bad.err;
}
