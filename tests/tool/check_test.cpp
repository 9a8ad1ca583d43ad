#include <gtest/gtest.h>

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

TEST(ToolCheck, ShowsEqualTextsInARowOnce) {
    TempFolder folder;
    std::string text = IesFile{.verticals = angles(0, 90, 10)}.text();
    text.replace(text.size() - 8, 8, "x\nx\nx\n");  // each of these numbers is reported
    folder.write("f.ies", text);
    const auto messages = runTool("check --json f.ies", folder).json().at(0)["messages"];
    EXPECT_EQ(messages.at(0), messages.at(1));
    const ToolResult human = runTool("check f.ies", folder);
    EXPECT_TRUE(human.says(messages[0].get<std::string>() + " (") && human.says(" times)")) << human.out;
}
