#include <CLI/CLI.hpp>
#include <iostream>
#include <memory>
#include <sstream>

#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/expandPaths.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/progress.h"
#include "tools/ovphoto/terminal.h"
#include "tools/ovphoto/webWarnings.h"

namespace OvTool {

namespace {

struct CheckOptions {
    std::vector<std::string> paths;
    std::string as;
    bool json = false;
};

struct CheckTotals {
    int well = 0;
    int withWarnings = 0;  // of those that are well
    int refused = 0;
    int skipped = 0;  // in folders, of no known format
};

void printJson(const ReadResult& result, const std::vector<std::string>& warnings) {
    printLine(Json{{"file", result.file},
                   {"ok", static_cast<bool>(result.web)},
                   {"format", result.format.empty() ? Json() : Json(result.format)},
                   {"messages", result.reasons()},
                   {"warnings", warnings}});
}

void printTexts(const char* label, const std::vector<std::string>& texts) {
    for (const std::string& text : texts) say(std::string("    ") + label + text);
}

void printText(const ReadResult& result, const std::vector<std::string>& warnings) {
    std::string format = result.format.empty() ? "-" : result.format;
    format.resize(std::max<std::size_t>(format.size(), 5), ' ');
    const char* verdict = !result.web ? "refused  " : warnings.empty() ? "ok       " : "warning  ";
    say(verdict + format + "  " + result.file);
    printTexts("", result.told());
    printTexts("warning: ", warnings);
}

void printSummary(const CheckTotals& totals) {
    const int files = totals.well + totals.refused;
    std::ostringstream line;
    line << files << (files == 1 ? " file: " : " files: ") << totals.well << " ok";
    if (totals.withWarnings > 0) line << " (" << totals.withWarnings << " with warnings)";
    line << ", " << totals.refused << " refused";
    if (totals.skipped > 0) line << "; " << totals.skipped << " more of no known format";
    say(line.str());
}

ReadResult readFound(const FoundFile& file, const CheckOptions& options, const HostSession& session) {
    if (file.error.empty()) return session.read(file.path, options.as);
    ReadResult result;
    result.file = file.path;
    result.error = file.error;
    return result;
}

void checkFile(const FoundFile& file, const CheckOptions& options, const HostSession& session, CheckTotals& totals,
               const Progress& progress) {
    const ReadResult result = readFound(file, options, session);
    const bool foreign = file.fromFolder && result.format.empty() && !session.formats().ofExtension(file.path);
    if (foreign) {
        ++totals.skipped;
        return;
    }
    const std::vector<std::string> warnings = result.web ? webWarnings(result) : std::vector<std::string>();
    ++(result.web ? totals.well : totals.refused);
    if (!warnings.empty()) ++totals.withWarnings;
    progress.clear();
    options.json ? printJson(result, warnings) : printText(result, warnings);
}

int runCheck(const CheckOptions& options, const HostSession& session) {
    const std::vector<FoundFile> files = expandPaths(options.paths);
    CheckTotals totals;
    Progress progress(files.size());
    for (const FoundFile& file : files) {
        if (!std::cout) break;
        progress.next();
        checkFile(file, options, session, totals, progress);
    }
    progress.clear();
    if (!options.json) printSummary(totals);
    return totals.refused == 0 ? exitWell : exitFailed;
}

}  // namespace

Action declareCheck(CLI::App& app) {
    auto options = std::make_shared<CheckOptions>();
    app.add_option("PATH", options->paths,
                   "Photometric files, - for standard input, or folders to search for them")
        ->required();
    addAsOption(app, options->as);
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) {
        options->as = sourceFormat(session, options->as);
        return runCheck(*options, session);
    };
}

}  // namespace OvTool
