#include "tools/ovphoto/commands/commands.h"

#include <CLI/CLI.hpp>

#include "tools/ovphoto/json.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

namespace {

constexpr Command allCommands[] = {
    {"formats", "List what the module builds, or tell the format of a file", declareFormats},
    {"info", "Show what is in photometric files", declareInfo},
    {"intensity", "Print the candela towards given directions", declareIntensity},
    {"convert", "Write photometric files in another format", declareConvert},
    {"make", "Write an isotropic, diffuse or spotlight distribution as a photometric file", declareMake},
    {"check", "Read files and folders and list their faults", declareCheck},
    {"plot", "Draw a diagram of photometric files, the sky, or the sun's paths", declarePlot},
    {"report", "Write a page about a photometric file, or an index of many", declareReport},
    {"sun", "Show where the sun stands and what light it and the sky give", declareSun},
    {"sky", "Show the sky's luminance in a direction, or its light on a surface", declareSky},
    {"settings", "Show or write saved settings of natural light", declareSettings},
    {"zones", "List the time zones", declareZones},
    {"months", "List the months", declareMonths},
};

}  // namespace

std::span<const Command> commands() { return allCommands; }

void addJsonFlag(CLI::App& app, bool& json) { app.add_flag("--json", json, "Print JSON, one object a line"); }

namespace {

CLI::Validator formatNames() {
    return CLI::IsMember({"IES", "CIBSE", "NIMB", "TBT"}, CLI::ignore_case).description("");
}

}  // namespace

void addAsOption(CLI::App& app, std::string& as) {
    app.add_option("--as", as, "Read as ies, cibse, nimb or tbt, whatever the content looks like")
        ->type_name("FORMAT")
        ->transform(formatNames());
}

CLI::Option* addToOption(CLI::App& app, const TargetFormat*& target) {
    const auto take = [&target](const std::string& name) { target = targetNamed(name); };
    return app
        .add_option_function<std::string>(
            "--to", take,
            "Write as ies, cibse, nimb or tbt; without it the output's extension says "
            "which (ies, cib, nmb, tbt)")
        ->type_name("FORMAT")
        ->transform(formatNames());
}

const TargetFormat* targetForOutput(const std::string& out) {
    if (const TargetFormat* target = targetOf(out)) return target;
    throw CLI::ValidationError("OUT",
                               "'" + out + "' does not end in .ies, .cib, .nmb or .tbt; --to names the format");
}

void showReasons(const std::string& file, const std::vector<std::string>& reasons) {
    for (const std::string& reason : reasons) complain(file + ": " + reason);
}

void showReasons(const ReadResult& result) { showReasons(result.file, result.told()); }

void printRefusal(const std::string& file, const std::vector<std::string>& reasons) {
    printLine(Json{{"file", file}, {"error", reasons.front()}, {"messages", reasons}});
}

void printRefusal(const ReadResult& result) { printRefusal(result.file, result.reasons()); }

}  // namespace OvTool
