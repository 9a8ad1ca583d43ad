#pragma once

#include <functional>
#include <span>
#include <string>

#include "tools/ovphoto/hostSession.h"

namespace CLI {
class App;
class Option;
}  // namespace CLI

// The tool's commands, one file each, and what they share.

namespace OvTool {

enum ExitStatus : int {
    exitWell = 0,
    exitFailed = 1,  // a file was refused or could not be read or written
    exitUsage = 2,
};

/// Runs a command whose arguments have been parsed; the result is the exit status.
using Action = std::function<int(HostSession&)>;

struct Command {
    const char* name;
    const char* summary;
    /// Declares the command's arguments on `app`.
    Action (*declare)(CLI::App& app);
};

/// All commands, in the order in which the help shows them.
std::span<const Command> commands();

Action declareFormats(CLI::App& app);
Action declareInfo(CLI::App& app);
Action declareIntensity(CLI::App& app);
Action declareConvert(CLI::App& app);
Action declareMake(CLI::App& app);
Action declareCheck(CLI::App& app);
Action declarePlot(CLI::App& app);
Action declareReport(CLI::App& app);
Action declareSun(CLI::App& app);
Action declareSky(CLI::App& app);
Action declareSettings(CLI::App& app);
Action declareZones(CLI::App& app);
Action declareMonths(CLI::App& app);

/// @{
/// Options that several commands have: --json, --as FORMAT, --to FORMAT. Formats are those of the loaded modules.
void addJsonFlag(CLI::App& app, bool& json);
void addAsOption(CLI::App& app, std::string& as);
CLI::Option* addToOption(CLI::App& app, std::string& to);
/// @}

/// What --as names, in the letters of the format's name; wrong usage where it names none. Empty where it is not given.
std::string sourceFormat(const HostSession& session, const std::string& as);
/// What --to names or, where it is not given, the extension of a file; wrong usage where that is none.
const Format& targetFormat(const HostSession& session, const std::string& to, const std::string& out);

/// Shows on standard error, as `FILE: text`, what was reported while the file was read and why it was refused.
void showReasons(const std::string& file, const std::vector<std::string>& reasons);
void showReasons(const ReadResult& result);
/// Prints a refused file's line of JSON; there is at least one reason.
void printRefusal(const std::string& file, const std::vector<std::string>& reasons);
void printRefusal(const ReadResult& result);

}  // namespace OvTool
