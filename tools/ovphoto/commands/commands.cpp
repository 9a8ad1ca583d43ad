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

void addAsOption(CLI::App& app, std::string& as) {
    app.add_option("--as", as, "Read as this format, such as ies, whatever the content looks like")
        ->type_name("FORMAT");
}

CLI::Option* addToOption(CLI::App& app, std::string& to) {
    return app
        .add_option("--to", to, "Write as this format, such as ies; without it the output's extension says which")
        ->type_name("FORMAT");
}

namespace {

const Format& namedBy(const char* option, const std::string& name, const Formats& formats) {
    if (const Format* format = formats.named(name)) return *format;
    throw CLI::ValidationError(option, name + " not in {" + formats.list(&Format::name) + "}");
}

/// ".ies, .cib or .tbt".
std::string extensions(const Formats& formats) {
    std::string list = "." + formats.list(&Format::extension);
    for (std::size_t comma = list.rfind(','), last = comma; comma != list.npos; comma = list.rfind(',', comma - 1))
        list.replace(comma, 1, comma == last ? " or ." : ", .");
    return list;
}

}  // namespace

std::string sourceFormat(const HostSession& session, const std::string& as) {
    return as.empty() ? as : namedBy("--as", as, session.formats()).name;
}

const Format& targetFormat(const HostSession& session, const std::string& to, const std::string& out) {
    if (!to.empty()) return namedBy("--to", to, session.formats());
    if (const Format* format = session.formats().ofExtension(out)) return *format;
    throw CLI::ValidationError(
        "OUT", "'" + out + "' does not end in " + extensions(session.formats()) + "; --to names the format");
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
