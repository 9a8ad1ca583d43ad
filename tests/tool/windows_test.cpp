#include <gtest/gtest.h>

#include <map>

#include "support/paths.h"
#include "tool/toolRun.h"

// The tool for Windows against that of this system: what they say and write is the same, byte for byte.

namespace fs = std::filesystem;

namespace {

/// What one tool prints, and every file that it writes.
std::map<std::string, std::string> outcome(const std::string& command, const std::string& tool) {
    const TempFolder folder;
    const ToolResult result = runShell(command, folder, "", tool);
    std::map<std::string, std::string> all{
        {"status", std::to_string(result.status)}, {"output", result.out}, {"messages", result.err}};
    for (const auto& entry : fs::recursive_directory_iterator(folder.path()))
        if (entry.is_regular_file()) all[entry.path().lexically_relative(folder.path())] = readBytes(entry.path());
    return all;
}

class WindowsTool : public testing::Test {
protected:
    void SetUp() override { ASSERT_TRUE(windowsTool()) << "OVPHOTO_WINDOWS_TOOL names no folder"; }
    /// Every text and file at a time, so that a difference is shown where it is.
    static void expectSame(const std::string& command, std::size_t files = 0) {
        const auto ours = outcome(command, binFolder());
        const auto theirs = outcome(command, windowsTool());
        EXPECT_EQ(ours.size(), theirs.size()) << command;
        EXPECT_GE(ours.size(), files + 3) << command;
        for (const auto& [name, bytes] : ours) {
            const auto found = theirs.find(name);
            ASSERT_TRUE(found != theirs.end()) << command << " does not write " << name;
            EXPECT_EQ(bytes, found->second) << command << ": " << name;
        }
    }
};

TEST_F(WindowsTool, ReadsAndConvertsEveryFileToTheSameBytes) {
    std::vector<std::string> folders{sourceFolder() + "/examples"};
    if (const char* samples = std::getenv("OVPHOTO_SAMPLES")) folders.emplace_back(samples);
    for (const std::string& folder : folders) {
        expectSame("ovphoto check --json '" + folder + "'");
        expectSame("ovphoto info --json --values '" + folder + "'/*.ies");
        for (const std::string target : {"ies", "cibse", "nimb", "tbt"}) {
            const std::string convert = "ovphoto convert --json '" + folder + "' --to " + target + " --into out";
            expectSame(convert, 3);
            expectSame(convert + " --as-saved", 3);
        }
        expectSame("ovphoto convert --json '" + folder + "' --to cibse --into out --jobs 2", 3);
    }
}

TEST_F(WindowsTool, WorksOutTheSameLight) {
    expectSame("for i in '" + sourceFolder() +
               "/examples/'*.ies; do ovphoto intensity --json \"$i\" 0,0 12.3,45.6 30,270 89.9,359.9; done");
    for (const std::string shape : {"isotropic", "diffuse", "spotlight --hotspot 31 --falloff 47"})
        for (const std::string out : {"out.ies", "out.cib", "out.nmb", "out.tbt"})
            expectSame("ovphoto make " + shape + " " + out + " --flux 1234.5", 1);
    for (const char* command : {"formats --json", "zones", "months --json"})
        expectSame(std::string("ovphoto ") + command);
    for (const std::string site :
         {"--latitude 52.5 --longitude 13.4E --time-zone -1 --date 03-21",
          "--latitude 33.9S --longitude 151.2E --time-zone -10 --date 12-02 --sky-cover 0.3",
          "--latitude 69.7 --longitude 19E --time-zone -1 --date 06-21 --sky-cover 1"}) {
        for (const std::string view :
             {"sun --day-table", "sun --year-table", "sun --json --time 17:23",
              "sky --json --time 9:41 --zenith 33 --azimuth 71", "sky --time 12 --normal 1,2,3"})
            expectSame("ovphoto " + view + " " + site);
        expectSame("ovphoto settings write a.txt " + site + " && ovphoto settings write a.bin --binary " + site,
                   2);
    }
}

}  // namespace
