#include "tools/ovphoto/commands/commands.h"

#include <CLI/CLI.hpp>
#include <iostream>

#include "tools/ovphoto/json.h"

namespace OvTool {

namespace {

constexpr Command allCommands[] = {
    {"formats", "List what the module builds, or tell the format of a file", declareFormats},
    {"info", "Show what is in photometric files", declareInfo},
    {"intensity", "Print the candela towards given directions", declareIntensity},
    {"convert", "Write a photometric file anew", declareConvert},
    {"check", "Read files and folders and list their faults", declareCheck},
};

}  // namespace

std::span<const Command> commands() { return allCommands; }

void addJsonFlag(CLI::App& app, bool& json) { app.add_flag("--json", json, "Print JSON, one object a line"); }

void addAsOption(CLI::App& app, std::string& as) {
    app.add_option("--as", as, "Read as ies, cibse, nimb or tbt, whatever the content looks like")
        ->type_name("FORMAT")
        ->transform(CLI::IsMember({"IES", "CIBSE", "NIMB", "TBT"}, CLI::ignore_case).description(""));
}

void showReasons(const ReadResult& result) {
    for (const std::string& reason : result.reasons()) std::cerr << result.file << ": " << reason << '\n';
}

void printRefusal(const ReadResult& result) {
    const std::vector<std::string> reasons = result.reasons();
    printLine(Json{{"file", result.file}, {"error", reasons.front()}, {"messages", reasons}});
}

}  // namespace OvTool
