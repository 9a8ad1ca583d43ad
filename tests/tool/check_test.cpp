#include <gtest/gtest.h>

#include "tool/toolRun.h"

namespace {

using Json = nlohmann::ordered_json;

TEST(ToolCheck, WarnsOfWhatAFileDoesNotShow) {
    struct WarningCase {
        const char* name;
        IesFile file;
        const char* warning;  // null: none
    };
    const auto minus = [](double v, double) { return v - 1; };
    const std::vector<double> turn{-90, 0, 90};
    const WarningCase cases[] = {
        {"plain", {}, nullptr},
        {"negative", {.candela = minus}, "1 candela value is negative"},
        {"factor 0", {.factors = "1 0 20"}, "ballast-lamp factor (future use) is 0"},
        {"multiplier 0", {.multiplier = "0"}, "candela multiplier is 0"},
        {"dark", {.candela = [](double, double) { return 0; }}, "dark"},
        {"tilt", {.tilt = "INCLUDE\n1\n2\n0 90\n1, 1"}, "tilt data"},
        {"tilt and factor 0", {.tilt = "include \n1\n2\n0 90\n1 1", .factors = "0 1 0"}, "ballast factor is 0"},
        {"B from 0", {.type = 2, .verticals = turn, .horizontals = {0, 45, 90}}, "unturned"},
        {"B around 0", {.type = 2, .verticals = turn, .horizontals = turn}, nullptr},
        {"A from 0", {.type = 3, .verticals = turn, .horizontals = {0, 45, 90}}, nullptr},
        {"open end", {.horizontals = angles(0, 345, 15)}, nullptr},
        {"end at 240", {.horizontals = angles(0, 240, 15)}, "end at 240 deg"},
    };
    TempFolder folder;
    for (const WarningCase& c : cases) {
        SCOPED_TRACE(c.name);
        folder.write("f.ies", c.file.text());
        const ToolResult result = runTool("check --json f.ies", folder);
        EXPECT_EQ(result.status, 0);
        const auto objects = result.json();
        ASSERT_EQ(objects.size(), 1U);
        EXPECT_EQ(objects[0]["ok"], true);
        const std::string warnings = objects[0]["warnings"].dump();
        if (c.warning) {
            EXPECT_NE(warnings.find(c.warning), std::string::npos) << warnings;
        } else {
            EXPECT_EQ(warnings, "[]");
        }
    }
}

TEST(ToolCheck, GoesThroughFoldersAndIsStoppedByNothing) {
    TempFolder folder;
    folder.write("good.ies", IesFile().text());
    folder.write("deep/down/a good.txt", IesFile().text());
    folder.write("deep/readme.txt", "no light here");
    folder.write("deep/empty.IES", "");
    folder.write("deep/bad.ies", IesFile{.tilt = "INCLUDE\n1\n2\n0 90\nx y"}.text());
    std::filesystem::create_symlink("gone.ies", folder.path() / "deep/link.ies");
    std::filesystem::create_directory_symlink("..", folder.path() / "deep/circle");

    const ToolResult result = runTool("check --json . letter.txt good.ies", folder);
    EXPECT_EQ(result.status, 1);
    std::vector<std::string> files;
    for (const Json& object : result.json()) {
        const std::string file = object["file"];
        files.push_back(file);
        const bool good = file.find("good.") != std::string::npos;
        EXPECT_EQ(object["ok"], good) << file;
        EXPECT_EQ(object["messages"].empty(), good) << file;
        EXPECT_EQ(object["format"], good || file == "./deep/bad.ies" ? Json("IES") : Json()) << file;
    }
    const std::vector<std::string> expected{"./deep/bad.ies",   "./deep/down/a good.txt",
                                            "./deep/empty.IES", "./deep/link.ies",
                                            "./good.ies",       "letter.txt",
                                            "good.ies"};
    EXPECT_EQ(files, expected);

    const ToolResult human = runTool("check deep good.ies", folder);
    EXPECT_TRUE(human.says("5 files: 2 ok, 3 refused; 1 more of no known format")) << human.out;
    EXPECT_EQ(human.err, "");  // no progress where no terminal is
    EXPECT_EQ(runTool("check good.ies", folder).status, 0);
}

TEST(ToolCheck, ShowsEqualTextsInARowOnce) {
    TempFolder folder;
    IesFile file;
    file.verticals = angles(0, 90, 10);
    std::string text = file.text();
    text.replace(text.size() - 8, 8, "x\nx\nx\n");  // each of these numbers is reported
    folder.write("f.ies", text);
    const auto messages = runTool("check --json f.ies", folder).json().at(0)["messages"];
    ASSERT_GE(messages.size(), 3U);
    EXPECT_EQ(messages[0], messages[1]);
    const ToolResult human = runTool("check f.ies", folder);
    EXPECT_TRUE(human.says(messages[0].get<std::string>() + " (")) << human.out;
    EXPECT_TRUE(human.says(" times)"));
}

}  // namespace
