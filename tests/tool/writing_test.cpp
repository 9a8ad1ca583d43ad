#include <gtest/gtest.h>

#include "tool/toolRun.h"

namespace fs = std::filesystem;

class ToolConvert : public testing::Test {
protected:
    ToolConvert() {
        IesFile file;
        file.horizontals = {0, 90, 180, 270, 360};
        file.candela = [](double v, double h) { return 100 + v + (h == 360 ? 0 : h); };
        folder.write("in.ies", file.text());
    }
    ToolResult run(const std::string& arguments) { return runTool("convert --as-saved " + arguments, folder); }
    std::string bytes(const std::string& name) { return readBytes(folder.path() / name); }
    std::size_t fileCount() {
        return static_cast<std::size_t>(std::distance(fs::directory_iterator(folder.path()), {}));
    }

    TempFolder folder;
};

TEST_F(ToolConvert, KeepsPermissionsAndFollowsLinks) {
    if (windowsTool()) GTEST_SKIP() << "a matter of POSIX";
    const auto real = folder.path() / "real.ies", link = folder.path() / "link.ies";
    folder.write("real.ies", "old");
    fs::permissions(real, fs::perms::owner_read | fs::perms::owner_write);
    fs::create_symlink("real.ies", link);
    ASSERT_EQ(run("in.ies link.ies").status, 0);
    EXPECT_TRUE(fs::is_symlink(link));
    EXPECT_EQ(bytes("real.ies").substr(0, 5), "IESNA");
    EXPECT_EQ(fs::status(real).permissions(), fs::perms::owner_read | fs::perms::owner_write);
}

TEST_F(ToolConvert, AFailureLeavesWhatWasThere) {
    folder.write("old.ies", "old");
    folder.write("bad.ies", "IESNA91\nTILT=NONE\n0\n");
    folder.write("locked.ies", "old");
    fs::create_directory(folder.path() / "folder");
    fs::permissions(folder.path() / "locked.ies", fs::perms::owner_read);
    struct Row {
        const char* arguments;
        const char* told;
    };
    std::vector<Row> rows{{"bad.ies old.ies", "bad.ies: "},
                          {"in.ies none/out.ies", "/out.ies: cannot be written"},
                          {"in.ies in.ies/out.ies", "/out.ies: cannot be written"},
                          {"in.ies folder --to ies", "is a folder"},
                          {"in.ies locked.ies", "is read-only"},
                          {"in.ies --to ies --into old.ies", "old.ies"}};
    if (!windowsTool()) {
        fs::create_symlink("nothing", folder.path() / "dangling.ies");
        fs::create_symlink("circle.ies", folder.path() / "circle.ies");
        rows.insert(rows.end(), {{"in.ies /dev/full --to ies", "is no regular file"},
                                 {"in.ies dangling.ies", "is a link that leads to nothing"},
                                 {"in.ies circle.ies", "cannot be written: "}});
    }
    const std::size_t before = fileCount();
    for (const Row& row : rows) {
        const ToolResult result = run(row.arguments);
        EXPECT_EQ(result.status, 1) << row.arguments;
        EXPECT_TRUE(result.says(row.told)) << row.arguments << result.err;
    }
    // No room to write, which Wine does not survive itself.
    if (!windowsTool()) {
        EXPECT_EQ(runShell("(ulimit -f 0; ovphoto convert in.ies old.ies 2>/dev/null)", folder).status, 1);
    }
    EXPECT_EQ(bytes("old.ies") + bytes("locked.ies"), "oldold");
    EXPECT_EQ(fileCount(), before);
}

TEST_F(ToolConvert, NoCommandWritesWhatItReads) {
    folder.write("in.svg", IesFile().text());
    folder.write("in.html", IesFile().text());
    folder.write("tilted.ies", IesFile{.tilt = "tilt.dat"}.text());
    folder.write("tilt.dat", "1 2 0 90 1 1\n");
    ASSERT_EQ(runTool("settings write sun.txt", folder).status, 0);
    std::vector<std::string> commands{"convert in.ies in.ies", "convert --as-saved in.ies ./in.ies",
                                      "convert in.ies --into . --to ies", "convert tilted.ies tilt.dat --to ies",
                                      "settings write sun.txt --from sun.txt --day 3"};
    if (!windowsTool()) {
        fs::create_symlink("in.ies", folder.path() / "link.ies");
        fs::create_directory(folder.path() / "out");
        fs::create_symlink("../in.ies", folder.path() / "out/in.ies");
        fs::create_hard_link(folder.path() / "in.ies", folder.path() / "other.ies");
        fs::create_hard_link(folder.path() / "sun.txt", folder.path() / "sun.svg");
        commands.insert(commands.end(), {"convert link.ies in.ies", "convert in.ies link.ies",
                                         "convert ./in.ies --into out --to ies", "convert in.ies other.ies",
                                         "convert - in.ies --to ies <link.ies", "plot in.svg -o in.svg",
                                         "plot --sky --from sun.txt -o sun.svg", "report in.html -o in.html",
                                         "report in.ies in.html -o in.html", "report . -o in.html"});
    }
    const std::size_t before = fileCount();
    std::string old;
    for (const char* file : {"in.ies", "in.svg", "in.html", "tilt.dat", "sun.txt"}) old += bytes(file);
    for (const std::string& command : commands) {
        const ToolResult result = runTool(command, folder);
        EXPECT_EQ(result.status, 1) << command;
        EXPECT_TRUE(result.says("is not written: it is one of the files to read")) << command << result.err;
    }
    std::string now;
    for (const char* file : {"in.ies", "in.svg", "in.html", "tilt.dat", "sun.txt"}) now += bytes(file);
    EXPECT_EQ(now, old);
    EXPECT_EQ(fileCount(), before);
}

TEST_F(ToolConvert, FilesAreOnTheDiskBeforeTheyHaveTheirName) {
    if (windowsTool()) GTEST_SKIP() << "a matter of POSIX";
    ASSERT_EQ(runFaulty("OVPHOTO_TRACE=trace", "convert in.ies out.ies", folder).status, 0);
    EXPECT_EQ(bytes("trace"), "file folder rename folder ");
}

TEST_F(ToolConvert, SignalsLeaveNothingUnfinished) {
    if (windowsTool()) GTEST_SKIP() << "a matter of POSIX";
    folder.write("old.ies", "old");
    const std::size_t before = fileCount();
    for (const int signal : {1, 2, 3, 15, 24}) {  // hang-up, interrupt, quit, termination, processor time
        const std::string fault = "OVPHOTO_SIGNAL=" + std::to_string(signal);
        EXPECT_EQ(runFaulty(fault, "convert in.ies old.ies", folder).status, 128 + signal);
        EXPECT_EQ(bytes("old.ies"), "old");
        EXPECT_EQ(fileCount(), before) << signal;
    }
    // What was to be ignored from the start, as nohup has it, is.
    EXPECT_EQ(runFaulty("--ignore-signal=HUP OVPHOTO_SIGNAL=1", "convert in.ies old.ies", folder).status, 0);
}

TEST_F(ToolConvert, WithoutMemoryTheToolSaysSoInOneLine) {
    if (windowsTool()) GTEST_SKIP() << "memory of other programs";
    folder.write("old.ies", "old");
    const std::size_t before = fileCount();
    for (const std::string command :
         {"convert --json in.ies old.ies", "check $(yes in.ies | head -n 20)", "months"}) {
        bool outputKept = !command.starts_with("check");  // what is told of files before the one that fails
        // Every place that begins a run, ever fewer of the thousands that follow.
        for (long place = 0; !HasFailure(); place += 1 + place / 12) {
            const ToolResult result = runFaulty("OVPHOTO_MEMORY=" + std::to_string(place), command, folder);
            if (result.status == 0) break;
            EXPECT_EQ(result.status, 1) << command << place;
            EXPECT_EQ(result.err, "ovphoto: not enough memory\n") << command << place;
            EXPECT_LT(place, 100000);
            outputKept = outputKept || result.says("ok       IES");
        }
        EXPECT_TRUE(outputKept);
        EXPECT_EQ(fileCount(), before);
    }
}
