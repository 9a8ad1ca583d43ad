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

TEST_F(ToolConvert, WhatItWritesReadsBackAndSavesTheSameAgain) {
    ASSERT_EQ(run("in.ies a.ies").status, 0);
    ASSERT_EQ(run("a.ies b.ies").status, 0);
    EXPECT_EQ(bytes("a.ies"), bytes("b.ies"));
    ASSERT_EQ(run("a.ies a.ies").status, 0);
    EXPECT_EQ(bytes("a.ies"), bytes("b.ies"));
    const auto info = runTool("info --json in.ies a.ies", folder).json();
    for (const char* key : {"thetas", "psis", "symmetry"}) EXPECT_EQ(info.at(0).at(key), info.at(1).at(key));
    EXPECT_EQ(fileCount(), 3U);  // nothing is left beside them
}

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
    fs::create_directory(folder.path() / "folder");
    const std::size_t before = fileCount();
    for (const std::string rest : {"bad.ies old.ies", "in.ies none/out.ies", "in.ies in.ies/out.ies",
                                   "in.ies folder --to ies", "in.ies /dev/full --to ies"}) {
        const ToolResult result = run(rest);
        EXPECT_EQ(result.status, 1) << rest;
        EXPECT_EQ(result.says("/out.ies: cannot be written"), rest.ends_with("/out.ies")) << result.err;
    }
    // No room to write.
    const char* full = "(trap '' XFSZ; ulimit -f 0; ovphoto convert --as-saved in.ies old.ies 2>/dev/null)";
    EXPECT_EQ(runShell(full, folder).status, 1);
    EXPECT_EQ(bytes("old.ies"), "old");
    EXPECT_EQ(fileCount(), before);
}
