#include <gtest/gtest.h>

#include "tool/toolRun.h"

namespace {

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

TEST_F(ToolConvert, WhatItWritesReadsBackAndSavesTheSameAgain) {
    ASSERT_EQ(run("in.ies a.ies").status, 0);
    ASSERT_EQ(run("a.ies b.ies").status, 0);
    EXPECT_EQ(bytes("a.ies"), bytes("b.ies"));
    ASSERT_EQ(run("a.ies a.ies").status, 0);
    EXPECT_EQ(bytes("a.ies"), bytes("b.ies"));
    const auto info = runTool("info --json in.ies a.ies", folder).json();
    ASSERT_EQ(info.size(), 2U);
    for (const char* key : {"thetas", "psis", "symmetry"}) EXPECT_EQ(info[0][key], info[1][key]);
    EXPECT_EQ(fileCount(), 3U);  // nothing is left beside them
}

TEST_F(ToolConvert, KeepsPermissionsAndFollowsLinks) {
    folder.write("real.ies", "old");
    fs::permissions(folder.path() / "real.ies", fs::perms::owner_read | fs::perms::owner_write);
    fs::create_symlink("real.ies", folder.path() / "link.ies");
    ASSERT_EQ(run("in.ies link.ies").status, 0);
    EXPECT_TRUE(fs::is_symlink(folder.path() / "link.ies"));
    EXPECT_EQ(bytes("real.ies").substr(0, 5), "IESNA");
    EXPECT_EQ(fs::status(folder.path() / "real.ies").permissions(),
              fs::perms::owner_read | fs::perms::owner_write);
}

TEST_F(ToolConvert, AFailureLeavesWhatWasThere) {
    folder.write("old.ies", "old");
    folder.write("bad.ies", "IESNA91\nTILT=NONE\n0\n");
    fs::create_directory(folder.path() / "folder");
    const std::size_t before = fileCount();
    const std::string commands[] = {
        "ovphoto convert --as-saved bad.ies old.ies",
        "ovphoto convert --as-saved in.ies none/out.ies",
        "ovphoto convert --as-saved in.ies in.ies/out.ies",
        "ovphoto convert --as-saved in.ies folder",
        "ovphoto convert --as-saved in.ies /dev/full",
        "(trap '' XFSZ; ulimit -f 0; ovphoto convert --as-saved in.ies old.ies 2>/dev/null)",  // no room to write
    };
    for (const std::string& command : commands) {
        EXPECT_EQ(runShell(command, folder).status, 1) << command;
        EXPECT_EQ(bytes("old.ies"), "old") << command;
        EXPECT_EQ(fileCount(), before) << command;
    }
    EXPECT_TRUE(runShell(commands[1], folder).says("none/out.ies: cannot be written"));
}

}  // namespace
