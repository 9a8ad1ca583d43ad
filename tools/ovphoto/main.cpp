#include <CLI/CLI.hpp>
#include <algorithm>
#include <iostream>
#include <utility>
#include <vector>

#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/platform.h"
#include "tools/ovphoto/terminal.h"

namespace {

using namespace OvTool;

constexpr const char* helpHint = "Run with --help for more information.";

/// Runs the command that was given; whatever it throws but wrong usage ends here as a message.
int runCommand(const Action& action, const std::string& module, bool verbose) {
    try {
        HostSession session(module);
        session.setVerbose(verbose);
        return action(session);
    } catch (const CLI::ParseError&) {
        throw;  // what the module alone can tell of the arguments
    } catch (...) {
        complain("ovphoto: " + currentExceptionText());
        return exitFailed;
    }
}

int parseAndRun(CLI::App& app, std::vector<std::string> arguments) {
    std::string module;
    app.add_option("--module", module, "Load this module instead of the one beside the tool")->type_name("PATH");
    bool verbose = false;
    app.add_flag("--verbose", verbose,
                 "Tell every message of a reader, those that only follow from others as well");
    app.set_version_flag("--version", "ovphoto " OVPHOTO_VERSION, "Print the version and exit");
    app.require_subcommand(0, 1);
    app.fallthrough();
    app.allow_windows_style_options(false);
    // What was wrong quotes arguments. Subcommands take this over.
    app.failure_message(
        [](const CLI::App*, const CLI::Error& error) { return printable(error.what()) + '\n' + helpHint + '\n'; });

    std::vector<std::pair<const CLI::App*, Action>> actions;
    for (const Command& command : commands()) {
        CLI::App* sub = app.add_subcommand(command.name, command.summary)->group("Commands");
        actions.emplace_back(sub, command.declare(*sub));
    }
    try {
        std::reverse(arguments.begin(), arguments.end());  // so they are parsed, from the end
        app.parse(arguments);
        for (const auto& [sub, action] : actions) {
            if (sub->parsed()) return runCommand(action, module, verbose);
        }
    } catch (const CLI::ParseError& error) {
        return app.exit(error) == 0 ? exitWell : exitUsage;
    }
    complain("A command is required");
    complain(helpHint);
    return exitUsage;
}

}  // namespace

int main(int argc, char** argv) {
    prepareStandardStreams();
    std::ios::sync_with_stdio(false);
    CLI::App app{"Reads, checks and converts photometric files of luminaires; works out the light of sun and sky.",
                 "ovphoto"};
    app.get_formatter()->label("SUBCOMMAND", "COMMAND");
    app.get_formatter()->label("TEXT", "");
    app.footer(
        "Exit status: 0 all well, 1 a file was refused or could not be read or written, 2 wrong usage.\n"
        "Angles are in degrees: theta from the axis, psi around it; latitudes positive towards north, "
        "longitudes,\n"
        "time zones and azimuths (0 is south) towards west.");
    const int status = parseAndRun(app, commandLine(argc, argv));
    if (std::cout.flush()) return status;
    // Whoever closes a pipe has read enough.
    if (!standardOutputIsClosedPipe()) complain("ovphoto: standard output cannot be written");
    return status == exitWell ? exitFailed : status;
}
