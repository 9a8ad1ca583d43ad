#include <gmock/gmock.h>

#include <filesystem>
#include <fstream>
#include <regex>
#include <set>
#include <sstream>
#include <string>
#include <vector>

#include "support/paths.h"
#include "tool/toolRun.h"

// What the documents promise: the README's examples print what stands there, links lead somewhere, and the list of what
// the module uses of its host is whole.

namespace {

namespace fs = std::filesystem;

using Names = std::set<std::string>;

std::string readText(const fs::path& path) {
    std::ostringstream text;
    text << std::ifstream(path).rdbuf();
    return text.str();
}

struct Example {
    std::string command;
    std::string output;
};

/// The commands of a document's fenced blocks, lines that start with "$ ", and what stands below each.
std::vector<Example> examplesOf(const fs::path& document) {
    std::vector<Example> examples;
    bool fenced = false, commandSeen = false;
    std::istringstream lines(readText(document));
    for (std::string line; std::getline(lines, line);) {
        if (line.starts_with("```")) {
            fenced = !fenced;
            commandSeen = false;
        } else if (fenced && line.starts_with("$ ")) {
            examples.push_back({line.substr(2), ""});
            commandSeen = true;
        } else if (commandSeen) {
            examples.back().output += line + '\n';
        }
    }
    return examples;
}

/// What a command prints in the source folder, and its status when that is not 0.
std::string runInSources(const std::string& command) {
    const ToolResult result = runShell("cd '" + sourceFolder() + "' && { " + command + "\n} 2>&1", TempFolder());
    return result.out + (result.status == 0 ? "" : "status " + std::to_string(result.status) + '\n');
}

/// What stands in `text` wherever the pattern's group is found.
Names allOf(const std::string& text, const char* pattern) {
    const std::regex regex(pattern);
    Names found;
    for (std::sregex_iterator match(text.begin(), text.end(), regex), end; match != end; ++match)
        found.insert((*match)[1]);
    return found;
}

std::vector<fs::path> documents() {
    std::vector<fs::path> found;
    for (const auto& entry : fs::directory_iterator(sourceFolder()))
        if (entry.path().extension() == ".md") found.push_back(entry.path());
    for (const auto& entry : fs::recursive_directory_iterator(sourceFolder() + "/docs"))
        if (entry.path().extension() == ".md") found.push_back(entry.path());
    return found;
}

TEST(Readme, ExamplesPrintWhatStandsThere) {
    const std::vector<Example> examples = examplesOf(sourceFolder() + "/README.md");
    ASSERT_GE(examples.size(), 3U);
    for (const Example& example : examples) {
        SCOPED_TRACE(example.command);
        EXPECT_THAT(example.command, testing::StartsWith("ovphoto "));
        EXPECT_EQ(runInSources(example.command), example.output);
    }
}

TEST(ManPage, NamesEveryCommandAndOptionAndNoOther) {
    const std::string page =
        std::regex_replace(readText(sourceFolder() + "/docs/man/ovphoto.1"), std::regex(R"(\\-)"), "-");
    const char* const option = R"((--[a-z][a-z-]*))";
    const std::string help = runInSources("ovphoto --help");
    Names options = allOf(help, option);
    const Names commands = allOf(help, R"(\n  ([a-z]+) )");
    EXPECT_GT(commands.size(), 5U);
    for (const std::string& command : commands) {
        EXPECT_THAT(page, testing::HasSubstr("\n.SS " + command));
        options.merge(allOf(runInSources("ovphoto " + command + " --help"), option));
    }
    options.merge(allOf(runInSources("ovphoto settings write --help"), option));
    EXPECT_EQ(allOf(page, option), options);
}

TEST(Documents, LinksLeadToFiles) {
    int links = 0;
    for (const fs::path& document : documents())
        for (const std::string& target : allOf(readText(document), R"(\]\(([^)#\s]+)(?:#[^)]*)?\))")) {
            if (target.starts_with("http")) continue;
            ++links;
            EXPECT_TRUE(fs::exists(document.parent_path() / target)) << document << " links to " << target;
        }
    EXPECT_GT(links, 5);
}

// What host.md says of the host against what the module takes of it.

/// The sources below the folders, one after another.
std::string sourcesIn(std::initializer_list<const char*> folders) {
    std::string text;
    for (const char* folder : folders)
        for (const auto& entry : fs::recursive_directory_iterator(sourceFolder() + '/' + folder))
            if (entry.path().extension() == ".h" || entry.path().extension() == ".cpp")
                text += readText(entry.path());
    return text;
}

Names minus(const Names& all, const Names& known) {
    Names rest;
    for (const std::string& name : all)
        if (!known.contains(name)) rest.insert(name);
    return rest;
}

/// The rows of the tables, their text between backticks.
const std::string& rows() {
    static const std::string text = [] {
        std::string kept;
        for (const std::string& line : allOf(readText(sourceFolder() + "/docs/host.md"), R"((?:^|\n)(\|[^\n]*))"))
            kept += line + '\n';
        return kept;
    }();
    return text;
}

TEST(Host, HeadersAreThoseThatTheModuleIncludes) {
    const char* const include = R"x(#include "(host/[^"]+)")x";
    Names headers = allOf(sourcesIn({"components", "include"}), include);
    // With what these include.
    for (Names more = headers; !more.empty();) {
        Names next;
        for (const std::string& header : more) next.merge(allOf(readText(sourceFolder() + '/' + header), include));
        more = minus(next, headers);
        headers.merge(Names(more));
    }
    EXPECT_EQ(allOf(rows(), R"(`(host/[^`]+)`)"), headers);
}

TEST(Host, NamesAreThoseThatTheModuleUses) {
    const std::string symbols = runInSources("nm -DC --undefined-only '" + modulePath() + "'");
    Names linked;
    for (const std::string& name :
         allOf(symbols, R"(\b(?:Ov|WendSDK::Util)::((?:\w+::)*(?:operator[<>]+|~?\w+)))"))
        linked.merge(allOf(name, R"((?:^|::)~?(operator[<>]+|\w+))"));
    EXPECT_GT(linked.size(), 20U);
    const Names names = allOf(rows(), R"(`([A-Za-z0-9]+|operator[<>]+)`)");
    EXPECT_EQ(minus(linked, names), Names());

    const char* const word = R"((operator[<>]+|\b[A-Za-z_]\w*))";
    EXPECT_EQ(minus(names, allOf(sourcesIn({"host"}), word)), Names());
    linked.merge(allOf(sourcesIn({"components", "include"}), word));
    EXPECT_EQ(minus(names, linked), Names());
}

}  // namespace
