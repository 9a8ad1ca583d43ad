#include <gmock/gmock.h>

#include <cmath>

#include "tool/toolRun.h"

namespace {

using Json = nlohmann::ordered_json;
namespace fs = std::filesystem;

class ToolConversion : public testing::Test {
protected:
    ToolConversion() {
        IesFile file;
        file.lamps = "1 2000";
        file.candela = [](double v, double) { return v == 0 ? 201 : v == 45 ? 100 : 0; };
        folder.write("in.ies", file.text());
    }
    Json convert(const std::string& arguments) {
        const ToolResult result = runTool("convert --json " + arguments, folder);
        EXPECT_EQ(result.status, 0) << arguments << result.err;
        return result.json().at(0);
    }
    Json info(const std::string& file) { return runTool("info --json --values " + file, folder).json().at(0); }
    static std::string texts(const Json& array) { return array.dump(); }

    TempFolder folder;
};

TEST_F(ToolConversion, EveryFormatHoldsTheLightAndGivesItBackInCandela) {
    const struct {
        const char* target;
        double tolerance;
        const char* unit;
        double lamps;  // lumens that it gives an IES file, the luminaire's where it knows of no lamps
    } cases[] = {{"ies", 1e-3, "cd", 2000},
                 {"cib", 1e-3, "cd", 457.3},
                 {"nmb", 0.51, "cd", 1000},
                 {"tbt", 0.011, "cd/klm", 2000}};
    for (const auto& c : cases) {
        const std::string file = std::string("out.") + c.target;
        const Json there = convert("in.ies " + file);
        EXPECT_TRUE(there["ok"] && there["messages"].empty()) << there;
        const Json found = info(file);
        EXPECT_EQ(found["fileUnit"], c.unit);
        EXPECT_EQ(found["unit"], "cd");
        EXPECT_NEAR(found["maxCandela"].get<double>(), 201, c.tolerance);
        EXPECT_NEAR(found["luminaireLumens"].get<double>(), 457.3, 1) << file;
        convert(file + " back.IES");  // the extension in any letter case
        EXPECT_NEAR(info("back.IES")["lampLumens"].get<double>(), c.lamps, 1) << file;
        for (const std::string& light : {file, std::string("back.IES")}) {
            const auto candela = runTool("intensity --json " + light + " 0,0 45,0 90,0", folder).json();
            for (const auto& [k, expected] : {std::pair{0U, 201.0}, {1, 100.0}, {2, 0.0}})
                EXPECT_NEAR(candela.at(k)["candela"].get<double>(), expected, c.tolerance) << light << k;
        }
    }
}

TEST_F(ToolConversion, FilesOfOneFormatKeepEveryValue) {
    const std::string nimb =
        "   0 180 120  90  30   0   1   2   3NIMB           1   1\nA\nB\nC\nD, a line to make it 72 bytes long\n"
        "  70  90  95  80  85  88  50  60  70  20 -30  40   5   0   1\n";
    folder.write("in.nmb", nimb);
    folder.write("in.tbt",  // for 328 lm and a reference of 500, in a circle of 4 steps
                 "title\n3\n1 1 1\n328 500 1 1 5 0\n4 3 5\n1.25 20 3\n1.25 7 0.5\n1.25 31.75 3\n1.25 7 1\n"
                 "1.25 20 3\n-1\n");
    folder.write("none.tbt", "title\n3\n1 1 1\n0 1000 1 1 5 0\n1 6 1\n60 50.25 48 30 9 0\n-1\n");
    convert("in.nmb out.nmb");
    EXPECT_EQ(readBytes(folder.path() / "out.nmb"), nimb);
    for (const std::string name : {"in", "none"}) {
        const Json report = convert(name + ".tbt out.tbt");
        EXPECT_EQ(report["maxCandelaDifference"], 0) << report;
        EXPECT_EQ(report["fluxDifferencePercent"], 0) << report;
        const auto numbers = [&](const std::string& file) {
            std::istringstream text(readBytes(folder.path() / file));
            std::string title;
            std::getline(text, title);
            std::vector<double> values;
            for (double value; text >> value;) values.push_back(value);
            values.erase(values.begin() + 6);  // the multiplier, which has no meaning
            return values;
        };
        EXPECT_EQ(numbers("out.tbt"), numbers(name + ".tbt")) << readBytes(folder.path() / "out.tbt");
    }
}

TEST_F(ToolConversion, WhatIsLostIsToldWhereverItIs) {
    const auto falling = [](double v, double) { return 1000 - 11 * v; };
    const auto beam = [](double v, double) { return 5000 * std::exp(-v * v / 13); };
    const auto narrow = [](double v, double h) { return 5000 * std::exp(-v * v / 4 - h * h / 8); };
    const auto tilted = [](double v, double h) { return 100 + h + (v > 0 ? 10 : 0); };
    const auto steep = [](double v, double) { return v == 0 ? 100 : v == 1 ? 1000 : 0; };
    const auto poles = [](double v, double h) { return v == 0 ? h : 200 + v; };
    const auto wide = angles(-60, 60, 20), wider = angles(-70, 70, 10);
    const auto few = angles(-10, 10, 0.5), laid = angles(-90, 90, 45);
    const std::pair<const char*, IesFile> files[] = {
        {"spot.ies", {.verticals = angles(0, 90, 0.5), .candela = beam}},
        {"ends.ies", {.verticals = angles(0, 90, 10), .candela = falling}},
        {"laid.ies", {.type = 2, .verticals = {-90, 90}, .horizontals = laid, .candela = tilted}},
        {"half.ies", {.type = 2, .verticals = {-90, 90}, .horizontals = laid}},
        {"narrow.ies", {.type = 3, .verticals = few, .horizontals = few, .candela = narrow}},
        {"steep.ies", {.verticals = {0, 1, 90}, .candela = steep}},
        {"floodB.ies", {.type = 2, .verticals = wide, .horizontals = wider}},
        {"floodA.ies", {.type = 3, .verticals = wide, .horizontals = wider}},
        {"sideA.ies", {.type = 3, .verticals = {-60, 0, 60}, .horizontals = {0, 60}}},
        {"sideB.ies", {.type = 2, .verticals = {-60, 0, 60}, .horizontals = {0, 60}}},
        {"poles.ies", {.verticals = angles(0, 90, 5), .horizontals = angles(90, 270, 45), .candela = poles}}};
    for (const auto& [name, file] : files) folder.write(name, file.text());
    folder.write("jump.tbt", "t\n3\n1 1 1\n1000 1000 1 1 5 0\n4 3 5\n9 9 9\n9 9 9\n9 9 9\n9 9 9\n9 5 9\n-1\n");
    std::string behind = "CIBSE/1\n\n\n\n\n\n\n\n1 2 0 0 0 1 0 0 0\n19 10\n";
    for (const double v : angles(-90, 90, 10)) behind += std::to_string(v) + "\n";
    for (const double h : angles(0, 90, 10)) behind += std::to_string(h) + "\n";
    const auto cosine = [](double degrees) { return std::cos(degrees * std::acos(-1) / 180); };
    for (const double h : angles(0, 90, 10))
        for (const double v : angles(-90, 90, 10)) behind += std::to_string(1000 * cosine(v) * cosine(h)) + "\n";
    folder.write("behind.cib", behind + "99 0 0 0\n");
    for (const char* target : {"ies", "cib", "nmb", "tbt"})
        for (const std::string type : {"A", "B"}) {
            const Json report = convert("side" + type + ".ies out." + target);
            const bool told = texts(report["warnings"]).find("type B") != std::string::npos;
            EXPECT_EQ(told, type == "B" && target != std::string("ies")) << report;
        }
    // What only grids of the same angles keep falls off within a step of others, where the range ends: no loss.
    for (const std::string flood : {"floodA.ies ", "floodB.ies "}) {
        for (const char* exact : {"out.ies", "out.cib"})
            EXPECT_LT(convert(flood + exact)["maxCandelaDifferencePercent"], 1e-3) << flood << exact;
        const Json even = convert(flood + "out.tbt");
        EXPECT_NEAR(even["fluxDifferencePercent"].get<double>(), 0, 0.2) << even;
        EXPECT_EQ(even["warnings"].size(), 1U) << even;
    }
    const struct {
        const char* files;
        double least, most;  // percent
        const char* warning;
    } cases[] = {
        {"spot.ies out.nmb", 0.1, 100, "the candela differ"},     // what steps of 1 degree lose,
        {"spot.ies out.tbt", 0, 0.1, "[]"},                       // finer ones keep
        {"ends.ies out.tbt", 0, 0.1, "at the rim of its range"},  // at 90 degrees, behind which it is dark
        {"floodA.ies out.tbt", 0, 0.1, "at the rim of its range"},
        {"floodB.ies out.tbt", 0, 0.1, "at the rim of its range"},
        {"laid.ies out.tbt", 0, 1, "a pole where planes"},                  // 10 to 200 cd
        {"half.ies out.tbt", 0, 1, ""},                                     // and dark behind
        {"jump.tbt out.ies", 0.1, 100, "the candela differ by up to 3.9"},  // next to plane 360
        {"behind.cib out.nmb", 0.1, 100, "the candela differ"},             // where values go on below 0, as 0
        {"narrow.ies out.tbt", 0.1, 100, "the candela differ"},             // finer steps were too many
        {"steep.ies out.nmb", 3, 100, "the candela differ"},  // the angles are held, the curve to 1 degree is not
        {"poles.ies out.tbt", 0, 10, ""},                     // another value in each plane, in a turned file
    };
    for (const auto& c : cases) {
        const Json report = convert(c.files);
        EXPECT_GE(report["maxCandelaDifferencePercent"], c.least) << c.files;
        EXPECT_LT(report["maxCandelaDifferencePercent"], c.most) << c.files;
        EXPECT_THAT(texts(report["warnings"]), testing::HasSubstr(c.warning)) << c.files;
    }
}

TEST_F(ToolConversion, ANegativeFluxIsToldAndTheLightStays) {
    IesFile file;
    file.candela = [](double v, double) { return v == 0 ? 100 : -50; };
    folder.write("negative.ies", file.text());
    for (const std::string target : {"ies", "cib", "nmb", "tbt"}) {
        const Json report = convert("negative.ies out." + target);
        EXPECT_NE(texts(report["warnings"]).find("negative"), std::string::npos) << report;
        const auto candela = runTool("intensity --json out." + target + " 0,0", folder).json().at(0);
        EXPECT_NEAR(candela["candela"].get<double>(), 100, 0.01) << target;
    }
}

TEST_F(ToolConversion, TellsWhatWasLost) {
    IesFile halves;
    halves.lamps = "1 2000";
    halves.candela = [](double v, double) { return v == 0 ? 100.5 : 20; };
    folder.write("halves.ies", halves.text());
    const Json nimb = convert("halves.ies out --to nimb");
    EXPECT_EQ(nimb["target"], "NIMB");
    EXPECT_NEAR(nimb["maxCandelaDifference"].get<double>(), 0.5, 1e-4);
    EXPECT_NEAR(nimb["maxCandelaDifferencePercent"].get<double>(), 50 / 100.5, 1e-4);
    EXPECT_NE(texts(nimb["warnings"]).find("NIMB holds no flux of lamps: readers take 1000 lm instead of 2000 lm"),
              std::string::npos);
    // 100 cd over half the sphere are 628.3 lm of the 1000 lm that the file's lamps give: nothing is wrong with that.
    folder.write("even.ies", IesFile{.lamps = "1 1000"}.text());
    const Json cibse = convert("even.ies out.cib");
    EXPECT_NEAR(cibse["fluxDifferencePercent"].get<double>(), 0, 1e-3);
    EXPECT_EQ(texts(cibse["warnings"]), "[]");
    EXPECT_EQ(texts(cibse["dropped"]), R"([{"key":"lampLumens","value":"1000"}])");
    EXPECT_LT(cibse["maxCandelaDifference"], 1e-3);
    EXPECT_NEAR(info("even.ies")["outputRatio"].get<double>(), 0.6283, 1e-3);
    EXPECT_TRUE(runTool("info even.ies", folder).says("1000 lm\n"));
    EXPECT_TRUE(runTool("info even.ies", folder).says(" lm, 62.8 % of the lamps'\n"));
    EXPECT_EQ(info("out.cib")["lampLumens"], Json());
    // A save holds relative values: 201 cd became 1.
    const Json saved = convert("in.ies --as-saved out.ies");
    EXPECT_NEAR(saved["maxCandelaDifference"].get<double>(), 200, 1e-3);
    EXPECT_NEAR(saved["fluxDifferencePercent"].get<double>(), 100 / 201.0 - 100, 0.01);
    EXPECT_TRUE(runTool("convert in.ies out.tbt", folder).says("largest difference 0"));
}

TEST_F(ToolConversion, TellsWhichFactsAreDropped) {
    std::string text = IesFile{.tilt = "INCLUDE\n1\n2\n0 90\n1 1"}.text();
    text.replace(text.find("[TEST]"), 10,
                 "[TEST] one\n[MORE]\n[OTHER] a line that goes far beyond what one of sixty or seventy or even "
                 "eighty characters can hold\n[LUMINAIRE] a lamp");
    text.replace(text.find(" 2 0 0 0\n"), 9, " 1 0 3 0\n");
    folder.write("rich.ies", text);
    const auto dropped = [&](const std::string& out) { return texts(convert("rich.ies " + out)["dropped"]); };
    const std::string tilt = R"({"key":"tilt","value":"INCLUDE"})";
    EXPECT_EQ(dropped("out.ies"), "[" + tilt + "]");
    const std::string size = tilt + R"(,{"key":"units","value":"feet"},{"key":"length","value":"3"}])";
    const std::string inTbt = dropped("out.tbt");
    EXPECT_EQ(inTbt.find(R"([{"key":"TEST","value":"one"},)"
                         R"({"key":"MORE","value":""},{"key":"OTHER")"),
              0U)
        << inTbt;
    EXPECT_TRUE(inTbt.ends_with(size)) << inTbt;
    EXPECT_EQ(inTbt.find("LUMINAIRE"), std::string::npos) << "it is the title";
    EXPECT_TRUE(
        runTool("convert rich.ies out.tbt", folder).says("; dropped TEST, MORE, OTHER, tilt, units, length"));

    // Keywords come back from label lines.
    folder.write("short.ies", IesFile{}.text());
    convert("short.ies short.cib");
    EXPECT_EQ(texts(convert("short.cib back.ies")["dropped"]), "[]");

    // What stays, and what is named, as keys.
    const auto keys = [&](const std::string& arguments) {
        std::string all;
        const Json report = convert(arguments);
        for (const Json& fact : report["dropped"]) all += fact["key"].get<std::string>() + ";";
        return all;
    };
    std::string blocks = IesFile{.lamps = "2 -1"}.text();
    blocks.replace(0, blocks.find("TILT"),
                   "IESNA:LM-63-2002\n[TEST] 0\n[BLOCK]\n[LAMP]\n[ENDBLOCK]\n[LUMCAT] 10\n"
                   "[OTHER] x\n[OTHER] y\n[OTHER] z\n");
    folder.write("blocks.ies", blocks);
    EXPECT_EQ(keys("blocks.ies out.ies"), "lamps;");
    EXPECT_EQ(readBytes(folder.path() / "out.ies").find(blocks.substr(0, blocks.find("[LUMCAT]"))), 0U);
    EXPECT_EQ(keys("blocks.ies out.cib"), "format;BLOCK;LAMP;ENDBLOCK;lamps;");
    EXPECT_EQ(keys("blocks.ies out.nmb"), "format;BLOCK;LAMP;ENDBLOCK;OTHER;OTHER;OTHER;lamps;");
    EXPECT_EQ(keys("blocks.ies out.tbt"), "format;TEST;BLOCK;LAMP;ENDBLOCK;LUMCAT;OTHER;OTHER;OTHER;lamps;");
    folder.write("factors.cib", "CIBSE/1\n0\n\n\n\n\n\n\n1 1 0 0 0 2 0 3 0\n2 1\n0 90\n0\n100 50\n99 0 0 0\n");
    EXPECT_EQ(keys("factors.cib out.cib"), "");
    EXPECT_EQ(keys("factors.cib out.ies"), "factors;");
    EXPECT_EQ(keys("factors.cib out.tbt"), "label 1;factors;");
    std::string twice = IesFile{}.text();
    twice.replace(twice.find("[TEST] one"), 10, "[TEST] 7\n[LUMINAIRE] 7");
    folder.write("twice.ies", twice);
    EXPECT_EQ(keys("twice.ies out.tbt"), "LUMINAIRE;") << "one title stands for one line";
    for (const bool own : {false, true}) {
        folder.write("in.tbt",
                     std::string("t\n3\n1 1 1\n2000 1000 ") + (own ? "3" : "2") + " 1 5 0\n1 2 1\n9 8\n-1\n");
        EXPECT_EQ(keys("in.tbt out.tbt"), "");
        EXPECT_EQ(runTool("info --json out.tbt", folder).json().at(0)["facts"][5]["value"], own ? "3" : "2");
        EXPECT_EQ(keys("in.tbt out.ies"), own ? "multiplier;" : "");
    }
}

TEST_F(ToolConversion, ASaveThatItsReaderRefusesIsWrittenWithAWarning) {
    // Vertical angles to 120 degrees are sampled, in planes that end 10 degrees before the half.
    folder.write("half.nmb",
                 "   0 180 120  90  30  90   0   0   0NIMB\nA\nB\nC\nD, a line to make it 72 bytes long\n"
                 "  90  90  90  80  85  88  50  60  70  20  30  40   0   0   0\n");
    const ToolResult saved = runTool("convert half.nmb --as-saved out.ies", folder);
    EXPECT_EQ(saved.status, 0) << saved.err;
    EXPECT_TRUE(saved.says("cannot be read back") && saved.says("no readable IES file")) << saved.out << saved.err;
    EXPECT_EQ(runTool("info out.ies", folder).status, 1);
    EXPECT_LT(convert("half.nmb out.ies")["maxCandelaDifferencePercent"], 0.1);
}

TEST_F(ToolConversion, GoesThroughFoldersInOrderWithAnyNumberOfJobs) {
    folder.write("lib/a.ies", IesFile().text());
    folder.write("lib/b.ies", "IESNA91\nTILT=NONE\nx\n");
    folder.write("lib/c.dxf", "no light");
    folder.write("lib/c.ies", IesFile{.candela = [](double, double) { return 7; }}.text());
    folder.write("lib/deep/-a.ies", IesFile().text());
    folder.write("lib/deep/a.IES", IesFile().text());
    folder.write("lib/deep/d e.txt", IesFile().text());
    folder.write("lib/deep/readme.txt", "no light");
    const std::string rest = " lib gone.ies --to cibse --into new/out";
    const ToolResult one = runTool("convert --json" + rest, folder);
    EXPECT_EQ(one.status, 1);
    std::string seen;
    for (const Json& report : one.json())
        seen += report["file"].get<std::string>() + (report["ok"] ? " ok;" : ";");
    EXPECT_EQ(
        seen,
        "lib/a.ies ok;lib/b.ies;lib/c.ies ok;lib/deep/-a.ies ok;lib/deep/a.IES;lib/deep/d e.txt ok;gone.ies;");
    EXPECT_TRUE(one.says("lib/deep/a.IES: new/out/a.cib is not written: it is made of lib/a.ies")) << one.err;
    const auto outputs = [&] {
        std::string bytes;
        for (const std::string name : {"a", "c", "-a", "d e"})
            bytes += readBytes(folder.path() / "new/out" / (name + ".cib"));
        return bytes;
    };
    const std::string written = outputs();
    EXPECT_EQ(written.substr(0, 7), "CIBSE/1");

    fs::remove_all(folder.path() / "new");
    const ToolResult many = runTool("convert --json --jobs 3" + rest, folder);
    EXPECT_EQ(many.out, one.out);
    EXPECT_EQ(many.err, one.err);
    EXPECT_EQ(many.status, 1);
    EXPECT_EQ(outputs(), written);
    EXPECT_TRUE(runTool("convert --jobs 2" + rest, folder)
                    .says("7 files: 4 converted, 3 failed; 2 more of no known format"));
}

TEST_F(ToolConversion, MakesDistributionsThatReadBack) {
    const double pi = std::acos(-1);
    const struct {
        const char* arguments;
        double candela;
        double flux;
    } cases[] = {{"isotropic", 1000 / (4 * pi), 1000},
                 {"isotropic --candela 10", 10, 40 * pi},
                 {"diffuse --flux 500", 500 / pi, 500},
                 {"spotlight --candela 800 --hotspot 60 --falloff 90", 800, 800 * pi}};
    for (const auto& c : cases) {
        for (const std::string out : {"out.ies", "out.cib", "out.tbt"}) {
            ASSERT_EQ(runTool("make " + (c.arguments + (" " + out)), folder).status, 0) << c.arguments;
            const Json light = info(out);
            EXPECT_NEAR(light["maxCandela"].get<double>(), c.candela, c.candela * 1e-4) << c.arguments << out;
            EXPECT_NEAR(light["lumens"].get<double>(), c.flux, c.flux * 1e-3) << c.arguments << out;
        }
    }
    // Whole degrees cannot hold so narrow a beam, nor four characters its peak.
    EXPECT_TRUE(
        runTool("make spotlight --hotspot 1 --falloff 3 out.nmb", folder).says("warning: the candela differ"));
}

}  // namespace
