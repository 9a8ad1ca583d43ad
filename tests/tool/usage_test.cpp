#include <gtest/gtest.h>

#include "tool/toolRun.h"

class ToolUsage : public testing::Test {
protected:
    ToolUsage() { folder.write("good.ies", IesFile().text()); }
    TempFolder folder;
};

TEST_F(ToolUsage, WrongArgumentsAreToldAndGiveStatus2) {
    // Rows of arguments and what the output or the messages say.
    const auto expectStatus = [&](int status, std::initializer_list<std::string> rows) {
        for (const std::string& row : rows) {
            const ToolResult result = runTool(row.substr(0, row.find('|')), folder);
            EXPECT_EQ(result.status, status) << row << result.err;
            EXPECT_TRUE(result.says(row.substr(row.find('|') + 1))) << row << result.out << result.err;
        }
    };
    expectStatus(2, {"|command is required",
                     "frobnicate|frobnicate",
                     "info|FILE",
                     "info good.ies --frob|--frob",
                     "info good.ies --values|--json",
                     "info good.ies --as pdf|pdf",
                     "intensity good.ies 10|'10'",
                     "intensity good.ies 1,2,3|'1,2,3'",
                     "intensity good.ies up,0|'up,0'",
                     "intensity good.ies 0,nan|'0,nan'",
                     "intensity good.ies 0,0 --frame upside|upside",
                     "intensity good.ies 0,0 --flux -5|-5",
                     "intensity good.ies 0,0 --flux 5lm|5lm",
                     "convert good.ies|OUT",
                     "convert good.ies b.pdf|b.pdf",
                     "convert good.ies b --to pdf|pdf",
                     "convert a b c --to ies|OUT",
                     "convert good.ies --into o|--to",
                     "convert good.ies a.ies --jobs 2|--into",
                     "convert good.ies --into o --to ies --jobs 0|'0'",
                     "make torch a.ies|torch",
                     "make diffuse a|'a'",
                     "make diffuse a.ies --hotspot 9|spotlight",
                     "make spotlight a.ies --hotspot 50 --falloff 20|the falloff's 20",
                     "make spotlight a.ies --hotspot 70|the falloff's 60",
                     "make spotlight a.ies --falloff 29|--hotspot: 30 degrees",
                     "make spotlight a.ies --hotspot 89.1|from 0.11 to 89 ",
                     "make spotlight a.ies --falloff 0|from 0.11 to 90 ",
                     "make isotropic a.ies --candela 1 --flux 1|--flux",
                     "make isotropic a.ies --flux 0|'0'"});
    if (windowsTool())
        expectStatus(2, {"plot good.ies -o a.svg|no pictures", "report good.ies -o a.html|no pictures"});
    expectStatus(0, {"--help|Exit status", "intensity --help|--frame", "--version|ovphoto 0.",
                     "info good.ies --as Ies|good"});
    expectStatus(1, {"info good.ies --module ./none.so|none.so"});
}

TEST_F(ToolUsage, WhatCannotBeReadIsToldByEveryCommand) {
    std::filesystem::create_directory(folder.path() / "folder");
    folder.write("empty.ies", "");
    folder.write("letter.txt", "Dear reader,\n");
    folder.write("cut.ies", "IESNA91\nTILT=NONE\n1 1000\n");
    for (const std::string text :
         {"missing.ies: cannot be opened", "folder: is a folder", "/dev/null: is no regular file",
          "empty.ies: not a photometric file of a known format",
          "letter.txt: not a photometric file of a known format", "cut.ies: "}) {
        if (windowsTool() && text.starts_with("/dev")) continue;
        for (std::string command :
             {"info @", "info --json @", "intensity @ 0,0", "convert --as-saved @ out.ies"}) {
            command.replace(command.find('@'), 1, text, 0, text.find(':'));
            const ToolResult result = runTool(command, folder);
            EXPECT_EQ(result.status, 1) << command;
            EXPECT_NE(result.err.find(text), std::string::npos) << command << result.err;
        }
    }
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "out.ies"));
}

TEST_F(ToolUsage, OutputThatCannotBeWrittenIsToldAndGivesStatus1) {
    for (const char* command : {"ovphoto formats >/dev/full", "ovphoto info good.ies >&-",
                                "ovphoto --help >/dev/full", "ovphoto check good.ies >/dev/full"}) {
        const ToolResult result = runShell(command, folder);
        EXPECT_EQ(result.status, 1) << command;
        EXPECT_TRUE(result.says("standard output cannot be written")) << command << result.err;
    }
    // An endless input ends with its reader.
    const ToolResult closed =
        runShell("{ yes 0,0 | { ovphoto intensity good.ies; echo status $? >&2; } | head -n 1; }", folder);
    EXPECT_TRUE(closed.says("status 1") && closed.says("100 cd")) << closed.out << closed.err;
    EXPECT_EQ(runShell("ovphoto intensity good.ies <&-", folder).status, 1);
}
