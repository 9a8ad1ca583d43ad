#include <gmock/gmock.h>

#include "tests/plot/svgPath.h"
#include "tool/toolRun.h"

namespace {

class ToolPlot : public testing::Test {
protected:
    ToolPlot() {
        folder.write("good.ies", IesFile().text());
        folder.write("bad.ies", "IESNA91\nTILT=NONE\nx\n");
    }
    ToolResult run(const std::string& arguments) { return runTool("plot " + arguments, folder); }
    std::string bytes(const std::string& name) { return readBytes(folder.path() / name); }
    std::size_t fileCount() {
        return static_cast<std::size_t>(std::distance(std::filesystem::directory_iterator(folder.path()), {}));
    }

    struct Refusal {
        int status;
        const char* arguments;
        const char* told;
    };

    /// Each run is refused and told of; nothing is made, and the file `old` stays.
    void expectLeavesNothing(const std::string& command, const std::string& old,
                             std::initializer_list<Refusal> runs) {
        folder.write(old, "old");
        const std::size_t before = fileCount();
        for (const Refusal& run : runs) {
            const ToolResult result = runTool(command + " " + run.arguments, folder);
            EXPECT_EQ(result.status, run.status) << run.arguments << result.err;
            EXPECT_TRUE(result.says(run.told)) << run.arguments << result.err;
        }
        EXPECT_EQ(fileCount(), before);
        EXPECT_EQ(bytes(old), "old");
    }

    TempFolder folder;
};

TEST_F(ToolPlot, EveryKindIsWrittenInEveryFormatWithNamesOfAnyBytes) {
    std::string text = IesFile().text();
    text.replace(text.find("[TEST] one"), 10, "[LUMINAIRE] <script>alert(1)</script> \xff & \"");
    folder.write("good.ies", text);
    for (const std::string what :
         {"good.ies", "good.ies --kind cartesian --planes 0,45,90.5", "good.ies --kind cone",
          "good.ies --kind isolux --height 2.5", "good.ies --kind solid --dark",
          "--sky --latitude 41 --longitude 74 --time-zone 5",
          "--sun-path --latitude 80 --longitude 0 --time-zone 0 --date 6-21",
          "good.ies good.ies --size 700x300"}) {
        for (const auto& [file, start] : {std::pair{"a.svg", "<?xml"}, {"a.PNG", "\x89PNG"}, {"a.pdf", "%PDF"}}) {
            const ToolResult result = run(what + " -o " + file);
            EXPECT_EQ(result.status, 0) << what << result.err;
            EXPECT_EQ(result.err + result.out, "") << what;
            EXPECT_THAT(bytes(file), testing::StartsWith(start)) << what;
            EXPECT_EQ(bytes(file).find("<script"), std::string::npos) << what;
        }
    }
}

TEST_F(ToolPlot, LightIsInCandelaWhateverTheUnitOfTheFile) {
    // Of which axes and legends are the same in a TBT file.
    IesFile file{.lamps = "1 700", .verticals = {0, 45, 90, 180}};
    file.candela = [](double v, double) { return 95 - v / 2; };
    folder.write("in.ies", file.text());
    ASSERT_EQ(runTool("convert in.ies in.tbt", folder).status, 0);
    for (const std::string kind : {"isolux", "cartesian"}) {
        ASSERT_EQ(run("in.ies -o a.svg --kind " + kind).status, 0);
        ASSERT_EQ(run("in.tbt -o b.svg --kind " + kind).status, 0);
        const OvPlot::Box a = extentOf(longestPath(bytes("a.svg"))), b = extentOf(longestPath(bytes("b.svg")));
        EXPECT_LT(OvPlot::distance({a.left, a.top}, {b.left, b.top}), 0.2) << kind;
        EXPECT_LT(OvPlot::distance({a.right, a.bottom}, {b.right, b.bottom}), 0.2) << kind;
    }
    // Reports: candela at the angles of the file, and both fluxes.
    file.lamps = "1 1000";
    file.horizontals = {90, 180, 270};
    folder.write("in.ies", file.text());
    ASSERT_EQ(runTool("report in.ies -o a.html", folder).status, 0);
    for (const char* text : {"<th scope=\"col\">90</th><th scope=\"col\">180</th><th scope=\"col\">270</th>",
                             "<th scope=\"row\">45</th><td>72.5</td>", "1000 lm", "of the lamps"})
        EXPECT_THAT(bytes("a.html"), testing::HasSubstr(text));
}

TEST_F(ToolPlot, WrongInputIsToldAndLeavesNothing) {
    std::filesystem::create_directory(folder.path() / "folder.svg");
    expectLeavesNothing(
        "plot", "old.svg",
        {
            {2, "-o a.svg", "FILE, --sky or --sun-path"},
            {2, "good.ies", "--out"},
            {2, "good.ies -o a.gif", "a.gif: does not end in .svg, .png or .pdf"},
            {2, "good.ies -o a.svg --planes ''", "--planes"},
            {2, "good.ies -o a.svg --planes 0,", "'0,'"},
            {2, "good.ies -o a.svg --planes 360", "'360'"},
            {2, "good.ies -o a.svg --planes 1,2,3,4,5,6,7,8,9", "--planes"},
            {2, "good.ies -o a.svg --size 0x600", "'0x600'"},
            {2, "good.ies -o a.svg --size 600x8001", "'600x8001'"},
            {2, "good.ies -o a.svg --size 600", "'600'"},
            {2, "good.ies -o a.svg --size 99999999999x600", "--size"},
            {2, "good.ies -o a.svg --kind pie", "'pie'"},
            {2, "good.ies -o a.svg --height 0", "'0'"},
            {2, "good.ies -o a.svg --latitude 3", "--sky"},
            {2, "good.ies --sky -o a.svg", "--sky"},
            {2, "--sky --sun-path -o a.svg", "--s"},
            {2, "--sky --kind polar -o a.svg", "--kind"},
            {2, "good.ies good.ies --kind cone -o a.svg", "shows one"},
            {2, "good.ies good.ies good.ies good.ies good.ies good.ies good.ies good.ies good.ies -o a.svg", "8"},
            {1, "good.ies bad.ies good.ies -o old.svg", "bad.ies: "},
            {1, "gone.ies -o old.svg", "gone.ies: cannot be opened"},
            {1, "good.ies -o none/a.svg", "none/a.svg: cannot be written"},
            {1, "good.ies -o folder.svg", "is a folder"},
            {1, "--sky --from bad.ies -o a.svg", "bad.ies"},
        });
}

TEST_F(ToolPlot, AReportIsOnePageOrAnIndexWithPages) {
    folder.write("lamps/deep/<i>.ies", IesFile().text());
    folder.write("lamps/readme.txt", "no light");
    const ToolResult one = runTool("report good.ies -o good.html", folder);
    EXPECT_EQ(one.status, 0) << one.err;
    EXPECT_THAT(bytes("good.html"), testing::HasSubstr("Nothing to report"));
    const ToolResult many = runTool("report lamps good.ies -o all.HTML", folder);
    EXPECT_TRUE(many.status == 0 && many.says("all.HTML: 2 files, 0 refused")) << many.out << many.err;
    EXPECT_THAT(bytes("all.HTML"), testing::HasSubstr("href=\"all-pages/0001-i-.html\">lamps/deep/&lt;i&gt;.ies"));
    EXPECT_THAT(bytes("all-pages/0002-good.html"), testing::HasSubstr("href=\"../all.HTML\""));
}

TEST_F(ToolPlot, APageIsBoundedAndAnIndexShowsPathsFromItself) {
    // Two fills stand for a million values, in 44 bytes.
    folder.write("lamps/large.tbt", "t\n3\n1 1 1\n9 9 1 1 5 0\n2 524288 2\n1Z0Z0-1");
    ASSERT_EQ(runShell("mkdir out; ovphoto report ./lamps \"$PWD/good.ies\" -o out/all.html", folder).err, "");
    EXPECT_THAT(bytes("out/all.html"),
                testing::AllOf(testing::HasSubstr(">../lamps/large.tbt<"), testing::HasSubstr(">../good.ies<")));
    const std::string page = bytes("out/all-pages/0001-large.html");
    EXPECT_THAT(page,
                testing::HasSubstr("of 2 horizontal angles. All values: <code>ovphoto info --json --values"));
    EXPECT_LT(page.size(), 500000U);
}

TEST_F(ToolPlot, AnOldReportStaysUntilTheNewOneIsComplete) {
    namespace fs = std::filesystem;
    const fs::path lamps = folder.path() / "lamps";
    folder.write("lamps/a.ies", IesFile().text());
    folder.write("lamps/b.ies", IesFile().text());
    ASSERT_EQ(runTool("report lamps -o all.html", folder).status, 0);
    const auto report = [&] {
        return bytes("all.html") + bytes("all-pages/0001-a.html") + bytes("all-pages/0002-b.html");
    };
    const auto files = [&] {
        return std::distance(fs::recursive_directory_iterator(folder.path()), fs::recursive_directory_iterator());
    };
    folder.write("lamps/a.ies", IesFile{.multiplier = "2"}.text());
    folder.write("lamps/b.ies", IesFile{.multiplier = "2"}.text());
    const std::string old = report();
    const auto before = files();
    const auto expectOld = [&](const ToolResult& result, int status) {
        EXPECT_EQ(result.status, status) << result.err;
        EXPECT_TRUE(report() == old);
        EXPECT_EQ(files(), before);
    };
    expectOld(runShell("(ulimit -f 64; ovphoto report lamps -o all.html)", folder), 1);  // no room for a page
    for (const char* file : {"all.html", "all-pages/0002-b.html"}) {
        fs::permissions(folder.path() / file, fs::perms::owner_read);
        expectOld(runTool("report lamps -o all.html", folder), 1);
        fs::permissions(folder.path() / file, fs::perms::owner_read | fs::perms::owner_write);
    }
    for (int place = 1; place <= 3; ++place)
        expectOld(runFaulty("OVPHOTO_RENAME=" + std::to_string(place), "report lamps -o all.html", folder), 1);
    expectOld(runFaulty("OVPHOTO_SIGNAL=15", "report lamps -o all.html", folder), 128 + 15);
    ASSERT_EQ(runTool("report lamps -o all.html", folder).status, 0);
    EXPECT_FALSE(report() == old);
    EXPECT_EQ(files(), before);
}

TEST_F(ToolPlot, AReportThatCannotBeMadeLeavesNothing) {
    folder.write("taken-pages", "a file");
    std::filesystem::create_directories(folder.path() / "empty");
    std::filesystem::create_directories(folder.path() / "folder.html");
    expectLeavesNothing("report", "old.html",
                        {
                            {2, "-o a.html", "PATH"},
                            {2, "good.ies", "--out"},
                            {2, "good.ies -o a.pdf", "a.pdf: does not end in .html"},
                            {1, "bad.ies -o old.html", "bad.ies: "},
                            {1, "gone.ies -o old.html", "cannot be opened"},
                            {1, "good.ies -o none/a.html", "none/a.html: cannot be written"},
                            {1, "empty -o old.html", "empty: no photometric file"},
                            {1, "good.ies good.ies -o none/a.html", "none/a-pages cannot be made"},
                            {1, "good.ies good.ies -o folder.html", "is a folder"},
                            {1, "good.ies good.ies -o taken.html", "taken-pages cannot be made"},
                        });
}

}  // namespace
