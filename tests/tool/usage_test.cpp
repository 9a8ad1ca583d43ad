#include <gtest/gtest.h>

#include "tool/toolRun.h"

namespace {

struct UsageCase {
    const char* name;
    const char* arguments;
    int status;
    const char* text;  // somewhere in the output or the messages
};

TEST(ToolUsage, WrongArgumentsAreToldAndGiveStatus2) {
    const UsageCase cases[] = {
        {"no command", "", 2, "command is required"},
        {"unknown command", "frobnicate", 2, "frobnicate"},
        {"no file", "info", 2, "FILE"},
        {"unknown option", "info good.ies --frob", 2, "--frob"},
        {"values without json", "info good.ies --values", 2, "--json"},
        {"unknown format", "info good.ies --as pdf", 2, "pdf"},
        {"half a direction", "intensity good.ies 10", 2, "'10'"},
        {"three angles", "intensity good.ies 1,2,3", 2, "'1,2,3'"},
        {"direction in words", "intensity good.ies up,0", 2, "'up,0'"},
        {"direction that is no number", "intensity good.ies 0,nan", 2, "'0,nan'"},
        {"unknown frame", "intensity good.ies 0,0 --frame upside", 2, "upside"},
        {"negative flux", "intensity good.ies 0,0 --flux -5", 2, "-5"},
        {"flux with a unit", "intensity good.ies 0,0 --flux 5lm", 2, "5lm"},
        {"conversion without its way", "convert good.ies b.ies", 2, "--as-saved"},
        {"conversion to nowhere", "convert good.ies --as-saved", 2, "OUT"},
        {"help", "--help", 0, "Exit status"},
        {"help of a command", "intensity --help", 0, "--frame"},
        {"version", "--version", 0, "ovphoto 0."},
        {"any case of a format", "info good.ies --as Ies", 0, "good"},
        {"option behind the command", "info good.ies --module ./none.so", 1, "none.so"},
    };
    TempFolder folder;
    folder.write("good.ies", IesFile().text());
    for (const UsageCase& c : cases) {
        SCOPED_TRACE(c.name);
        const ToolResult result = runTool(c.arguments, folder);
        EXPECT_EQ(result.status, c.status) << result.err;
        EXPECT_TRUE(result.says(c.text)) << result.out << result.err;
    }
}

TEST(ToolUsage, WhatCannotBeReadIsToldByEveryCommand) {
    struct BadFile {
        const char* name;
        const char* text;
    };
    const BadFile files[] = {
        {"missing.ies", "missing.ies: cannot be opened"},
        {"folder", "folder: is a folder"},
        {"/dev/null", "/dev/null: is no regular file"},
        {"empty.ies", "empty.ies: not a photometric file of a known format"},
        {"letter.txt", "letter.txt: not a photometric file of a known format"},
        {"cut.ies", "cut.ies: "},
    };
    TempFolder folder;
    std::filesystem::create_directory(folder.path() / "folder");
    folder.write("empty.ies", "");
    folder.write("letter.txt", "Dear reader,\n");
    folder.write("cut.ies", "IESNA91\nTILT=NONE\n1 1000\n");
    for (const BadFile& file : files) {
        SCOPED_TRACE(file.name);
        for (std::string command :
             {"info @", "info --json @", "intensity @ 0,0", "convert --as-saved @ out.ies"}) {
            const ToolResult result = runTool(command.replace(command.find('@'), 1, file.name), folder);
            EXPECT_EQ(result.status, 1) << command;
            EXPECT_NE(result.err.find(file.text), std::string::npos) << result.err;
        }
    }
    EXPECT_FALSE(std::filesystem::exists(folder.path() / "out.ies"));
}

TEST(ToolUsage, OutputThatCannotBeWrittenIsToldAndGivesStatus1) {
    TempFolder folder;
    folder.write("good.ies", IesFile().text());
    for (const char* command : {"ovphoto formats >/dev/full", "ovphoto info good.ies >&-",
                                "ovphoto --help >/dev/full", "ovphoto check good.ies >/dev/full"}) {
        const ToolResult result = runShell(command, folder);
        EXPECT_EQ(result.status, 1) << command;
        EXPECT_TRUE(result.says("standard output cannot be written")) << command << result.err;
    }
    // An endless input ends with its reader.
    const ToolResult closed =
        runShell("{ yes 0,0 | { ovphoto intensity good.ies; echo status $? >&2; } | head -n 1; }", folder);
    EXPECT_TRUE(closed.says("status 1")) << closed.err;
    EXPECT_TRUE(closed.says("100 cd"));
    EXPECT_EQ(runShell("ovphoto intensity good.ies <&-", folder).status, 1);
}

}  // namespace
