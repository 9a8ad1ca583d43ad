#include <gtest/gtest.h>

#include <algorithm>

#include "tool/toolRun.h"

using Json = nlohmann::ordered_json;

TEST(ToolCheck, WarnsOfWhatAFileDoesNotShow) {
    const std::vector<double> turn{-90, 0, 90};
    const struct {
        const char* warning;
        IesFile file;
    } cases[] = {
        {"[]", {}},
        {"1 candela value is negative", {.candela = [](double v, double) { return v - 1; }}},
        {"flux of the luminaire is negative", {.candela = [](double v, double) { return v == 0 ? 1 : -1; }}},
        {"ballast-lamp factor (future use) is 0", {.factors = "1 0 20"}},
        {"candela multiplier is 0", {.multiplier = "0"}},
        {"dark", {.candela = [](double, double) { return 0; }}},
        {"tilt data", {.tilt = "INCLUDE\n1\n2\n0 90\n1, 1"}},
        {"ballast factor is 0", {.tilt = "include \n1\n2\n0 90\n1 1", .factors = "0 1 0"}},
        {"unturned", {.type = 2, .verticals = turn, .horizontals = {0, 45, 90}}},
        {"[]", {.type = 2, .verticals = turn, .horizontals = turn}},
        {"[]", {.type = 3, .verticals = turn, .horizontals = {0, 45, 90}}},
        {"[]", {.horizontals = angles(0, 345, 15)}},
        {"end at 240 deg", {.horizontals = angles(0, 240, 15)}},
    };
    TempFolder folder;
    for (const auto& c : cases) {
        folder.write("f.ies", c.file.text());
        const ToolResult result = runTool("check --json f.ies", folder);
        const Json object = result.json().at(0);
        EXPECT_TRUE(result.status == 0 && object["ok"]) << object;
        EXPECT_NE(object["warnings"].dump().find(c.warning), std::string::npos) << c.warning << object;
    }
}

TEST(ToolCheck, GoesThroughFoldersAndIsStoppedByNothing) {
    TempFolder folder;
    folder.write("good.ies", IesFile().text());
    folder.write("deep/down/a good.txt", IesFile().text());
    folder.write("deep/readme.txt", "no light here");
    folder.write("deep/empty.IES", "");
    folder.write("deep/bad.ies", IesFile{.tilt = "INCLUDE\n1\n2\n0 90\nx y"}.text());
    if (windowsTool()) {
        folder.write("deep/link.ies", "");
    } else {
        std::filesystem::create_symlink("gone.ies", folder.path() / "deep/link.ies");
        std::filesystem::create_directory_symlink("..", folder.path() / "deep/circle");
    }

    const ToolResult result = runTool("check --json . letter.txt good.ies", folder);
    EXPECT_EQ(result.status, 1);
    std::vector<std::string> files;
    for (const Json& object : result.json()) {
        const std::string& file = files.emplace_back(object["file"]);
        const bool good = file.find("good.") != std::string::npos;
        EXPECT_EQ(object["ok"], good) << file;
        EXPECT_EQ(object["messages"].empty(), good) << file;
        EXPECT_EQ(object["format"], good || file == "./deep/bad.ies" ? Json("IES") : Json()) << file;
    }
    EXPECT_EQ(files, (std::vector<std::string>{"./deep/bad.ies", "./deep/down/a good.txt", "./deep/empty.IES",
                                               "./deep/link.ies", "./good.ies", "letter.txt", "good.ies"}));
    const ToolResult human = runTool("check deep good.ies", folder);
    EXPECT_TRUE(human.says("5 files: 2 ok, 3 refused; 1 more of no known format")) << human.out;
    EXPECT_EQ(human.err, "");  // no progress where no terminal is
}

/// People are told the line, equal texts in a row once, and not what only follows; JSON has everything.
TEST(ToolCheck, TellsWhereTheFaultIsAndNotWhatFollowsFromIt) {
    const std::string good =
        IesFile{.tilt = "INCLUDE\n1\n2\n0 90\n1 1"}.text();  // 16 lines, candela on the last 3
    const auto changed = [&](std::size_t line, const std::string& text) {
        std::istringstream lines(good);
        std::string result, each;
        for (std::size_t i = 1; std::getline(lines, each); ++i) result += (i == line ? text : each) + "\n";
        return result;
    };
    const auto ended = [](std::string text, const std::string& end) {
        for (std::size_t i = 0; (i = text.find('\n', i)) != std::string::npos; i += end.size())
            text.replace(i, 1, end);
        return text;
    };
    const std::string faulty = changed(8, "x -1 1 3 1 1 2 0 0 0");
    const std::string threeBad = good.substr(0, good.size() - 12) + "x\n x\r\n x\n";
    const struct {
        const char* name;
        std::string text;
        std::size_t messages;  // in all
        const char* told;      // what the only line of those told ends in
    } cases[] = {{"word for a number", faulty, 2, " (line 8)"},
                 {"CR LF", ended(faulty, "\r\n"), 2, " (line 8)"},
                 {"CR", ended(faulty, "\r"), 2, " (line 8)"},
                 {"number out of range", changed(8, "1 -1 1 1 1 1 2 0 0 0"), 1, " (line 8)"},
                 {"tilt data", changed(6, "0 70"), 1, " (line 6)"},
                 {"end of the file", good.substr(0, good.size() - 9) + "\n\n", 2, " (line 14)"},
                 {"no number", "IESNA91\nTILT=NONE\n", 2, " (line 2)"},
                 {"equal texts", threeBad, 4, " (3 times, from line 14 on)"},
                 {"values", changed(13, "45"), 1, "0."},
                 {"tilt file", "IESNA91\nTILT=bad.tlt\n1", 2, "start."}};
    TempFolder folder;
    folder.write("bad.tlt", "x");
    for (const auto& c : cases) {
        folder.write("f.ies", c.text);
        const Json object = runTool("check --json f.ies", folder).json().at(0);
        EXPECT_EQ(object["messages"].size(), c.messages) << c.name << object;
        const ToolResult human = runTool("info f.ies", folder);
        EXPECT_EQ(std::count(human.err.begin(), human.err.end(), '\n'), 1) << c.name << human.err;
        EXPECT_TRUE(human.err.ends_with(std::string(c.told) + "\n")) << c.name << human.err;
        EXPECT_EQ(runTool("convert f.ies out.ies", folder).err, human.err) << c.name;
        EXPECT_EQ(runTool("convert f.ies --to tbt --into out --jobs 2", folder).err, human.err) << c.name;
        const std::string all = runTool("info f.ies --verbose", folder).err;
        EXPECT_EQ(static_cast<std::size_t>(std::count(all.begin(), all.end(), '\n')), c.messages) << c.name << all;
    }
    folder.write("f.ies", good);
    runTool("convert f.ies f.nmb", folder);
    folder.write("f.nmb", readBytes(folder.path() / "f.nmb").substr(0, 90));
    const ToolResult nimb = runTool("check f.nmb", folder);  // whose reader names the line itself
    EXPECT_TRUE(nimb.says("refused  NIMB") && nimb.says("Line ") && !nimb.says("(line")) << nimb.out;
    folder.write("f.ies", faulty);
    EXPECT_TRUE(runShell("LC_ALL=de ovphoto check f.ies", folder).says("(Zeile 8)"));
}

TEST(ToolCheck, SaysWhatAnUnknownFileMayBe) {
    const std::pair<std::string, const char*> cases[] = {
        {"", "it is empty"},
        {"\x1F\x8B\b", "gzip"},
        {std::string("PK\3\4\0\0", 6), "zip archive"},
        {std::string("\xFF\xFEI\0E\0", 6), "UTF-16"},
        {std::string("I\0E\0S\0N\0A\0"
                     "9\0"
                     "1\0\n\0",
                     16),
         "UTF-16"},
        {"Maker\r\n1\r\n 0 \r\n24\r\n15\r\n37\r\n2,5\r\nReport", "EULUMDAT"},
        {"IESNA:LM-63-2002\rTILT=NONE\r", "--as ies"},
        {"Dear reader,\r", "carriage returns alone"},
        {"Maker\n9\n0\n24\n15\n37\n2\n", "known format\n"},
        {"Dear reader,\n1\n2\n3\n", "known format\n"}};
    TempFolder folder;
    for (const auto& [bytes, hint] : cases) {
        folder.write("f", bytes);
        EXPECT_TRUE(runTool("check f", folder).says("not a photometric file of a known format")) << hint;
        EXPECT_TRUE(runTool("check f", folder).says(hint)) << hint << runTool("check f", folder).out;
    }
    folder.write("f", cases[3].first);
    EXPECT_TRUE(runTool("check f --as ies", folder).says("UTF-16"));
}
