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
    // A file of 300 bytes or so, and standard input without end.
    expectStatus(0, {"info good.ies --max-size 1K|good", "check good.ies --max-size 9G|1 ok"});
    expectStatus(1,
                 {"info good.ies --max-size 50|good.ies: is larger than 50 bytes", "check . --max-size 50|larger",
                  "convert good.ies --into o --to tbt --jobs 2 --max-size 50|larger",
                  "convert good.ies out.ies --max-size 0|larger", "sun --from good.ies --max-size 9|larger"});
    expectStatus(2, {"--max-size 9T formats|'9T'", "--max-size 99999999999G formats|--max-size",
                     "--max-size -1 formats|-1", "--max-size '' formats|--max-size"});
    EXPECT_EQ(runShell("yes | ovphoto info - --max-size 1M", folder).err,
              "-: is larger than 1048576 bytes; --max-size allows more\n");
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
             {"info @", "info --json @ good.ies", "intensity @ 0,0", "convert --as-saved @ out.ies"}) {
            command.replace(command.find('@'), 1, text, 0, text.find(':'));
            const ToolResult result = runTool(command, folder);
            EXPECT_EQ(result.status, 1) << command;
            EXPECT_NE(result.err.find(text), std::string::npos) << command << result.err;
            if (command.find("good") == command.npos) continue;
            EXPECT_EQ(result.json().at(0)["file"].get<std::string>(), text.substr(0, text.find(':')));
            EXPECT_NE(result.json().at(0)["error"].get<std::string>(), "");
            EXPECT_EQ(result.json().at(1)["symmetry"], "Axial");  // what is refused stops nothing
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
    // An endless input ends with its reader, and who has read enough is no fault.
    for (const std::string many :
         {"yes 0,0 | { ovphoto intensity good.ies", "{ ovphoto check $(yes good.ies | head -n 999)",
          "{ ovphoto info $(yes good.ies | head -n 999)"}) {
        const ToolResult closed = runShell("{ " + many + "; echo status $? >&2; } | head -n 1; }", folder);
        // Wine tells programs nothing of a closed pipe.
        if (!windowsTool()) {
            EXPECT_EQ(closed.err, "status 1\n") << many;
        }
        EXPECT_NE(closed.out, "") << many;
    }
    EXPECT_EQ(runShell("ovphoto intensity good.ies <&-", folder).status, 1);
}

/// What "-" gives is what a file gives, but for names.
TEST_F(ToolUsage, StandardInputAndOutputAreNamedByADash) {
    std::string light = readBytes(folder.path() / "good.ies");
    light.replace(light.find("TEST"), 4, "LUMINAIRE");  // what pictures show for a name
    folder.write("good.ies", light);
    const auto renamed = [](std::string text) {
        for (const auto& [name, dash] : {std::pair<std::string, std::string>{"good.ies", "-"}, {"good", "stdin"}})
            for (std::size_t at; (at = text.find(name)) != std::string::npos;) text.replace(at, name.size(), dash);
        return text;
    };
    std::vector<std::string> commands{"info @",         "info @ --json", "intensity @ 0,0 45,0",
                                      "check @ --json", "check @",       "formats --detect @"};
    for (const char* output : {"convert @ OUT --to tbt", "convert @ OUT --to ies", "plot @ -o OUT --format png",
                               "plot @ -o OUT.svg", "report @ -o OUT.html"}) {
        if (windowsTool() && std::string(output).find("-o") != std::string::npos) continue;
        commands.emplace_back(output);
    }
    for (const std::string& command : commands) {
        std::string byName = command, byDash = command;
        byName.replace(byName.find('@'), 1, "good.ies");
        byDash.replace(byDash.find('@'), 1, "-");
        std::string wanted;
        const std::size_t out = command.find("OUT");
        if (out != std::string::npos) {
            const std::string file = command.substr(out, command.find(' ', out) - out);
            byDash.replace(byDash.find(file), file.size(), "-");
            EXPECT_EQ(runTool(byName, folder).status, 0) << byName;
            wanted = readBytes(folder.path() / file);
        } else {
            wanted = runTool(byName, folder).out;
        }
        const ToolResult result = runTool(byDash, folder, light);
        EXPECT_EQ(result.status, 0) << byDash << result.err;
        EXPECT_NE(wanted, "") << byName;
        EXPECT_TRUE(renamed(result.out) == renamed(wanted)) << byDash;
    }
    EXPECT_EQ(runTool("check - -", folder, light).status, 1);
    EXPECT_TRUE(runTool("check - -", folder, light).says("only once"));
    for (const std::string wrong : {"intensity -", "convert - -", "convert - - --to ies --json",
                                    "convert - --into o --to ies", "report - good.ies -o -", "report . -o -"}) {
        EXPECT_EQ(runTool(wrong, folder, light).status, 2) << wrong;
    }
}

TEST_F(ToolUsage, WhatIsShownToPeopleActsOnNoTerminal) {
    if (windowsTool()) GTEST_SKIP() << "names there hold no control characters";
    std::string file = IesFile{.tilt = "a\x1b]0;x\x07"}.text();
    file.replace(file.find("[TEST] one"), 10,
                 "[TEST] \x1b[2J \xc2\x9b"
                 "1m M\xc3\xbcller \xe2\x80\xae\x7f\t.");
    const std::string name =
        "n\nok       IES    \x1b[31m\x9b"
        "1m\xc2\x85\r.ies";
    folder.write("in/" + name, file);
    folder.write("in/a\x1b]0;x\x07", "1 2 0 90 1 1");
    folder.write("bad\x1b[1m\n.ies", "IESNA91\nTILT=\x1b[2J\n");
    const std::string in = "'in/" + name + "'", bad = "'bad\x1b[1m\n.ies'", unknown = "'\x1b[1m\nok'";
    for (const std::string& command : {"info " + in,
                                       "check in " + bad,
                                       "intensity " + in + " 0,0",
                                       "intensity " + bad + " 0,0",
                                       "convert " + in + " --into out --to nimb",
                                       "convert " + bad + " " + in + " --to ies --into out --jobs 2",
                                       "convert " + in + " 'in/x\n\x1b/y.ies'",
                                       "plot " + bad + " -o 'x\x1b\n'",
                                       "report in " + bad + " -o out/i.html",
                                       "formats --detect " + in,
                                       "settings show " + bad,
                                       "settings show " + unknown,
                                       "sun --from " + bad,
                                       "make isotropic " + unknown + " --to ies",
                                       "make isotropic " + unknown,
                                       "info --as " + unknown,
                                       unknown,
                                       "info " + in + " --module " + unknown,
                                       "sun --date " + unknown,
                                       "info --json " + in + " " + bad}) {
        const ToolResult result = runTool(command, folder);
        const std::string shown = result.out + result.err;
        EXPECT_GT(shown.size(), 0U) << command;
        for (std::size_t i = 0; i < shown.size(); ++i) {
            const auto c = static_cast<unsigned char>(shown[i]);
            const bool second = (c & 0xe0) == 0x80 && i > 0 && shown[i - 1] == '\xc2';
            EXPECT_TRUE((c >= ' ' || c == '\n') && c != 0x7f && !second) << command << '\n' << shown;
        }
        EXPECT_EQ(("\n" + shown).find("\nok"), std::string::npos) << command << shown;
    }
    const ToolResult human = runTool("info " + in, folder);
    EXPECT_TRUE(human.says("in/n\\nok       IES    \\x1b[31m\\x9b1m\\x85\\r.ies\n")) << human.out;
    EXPECT_TRUE(human.says("  \\x1b[2J \\x9b1m M\u00fcller \\u202e\\x7f .\n")) << human.out;
    // JSON is exact, but for the byte that is no text.
    const auto exact = runTool("info --json " + in, folder).json().at(0);
    EXPECT_EQ(exact["file"],
              "in/n\nok       IES    \x1b[31m\ufffd"
              "1m\u0085\r.ies");
    EXPECT_EQ(exact["facts"][1]["value"],
              "\x1b[2J \u009b"
              "1m M\u00fcller \u202e\x7f\t.");
}
