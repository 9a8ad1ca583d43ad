#include <CLI/CLI.hpp>
#include <algorithm>
#include <charconv>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <exception>
#include <iostream>
#include <optional>
#include <utility>
#include <vector>

#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/platform.h"
#include "tools/ovphoto/terminal.h"

namespace {

using namespace OvTool;

constexpr const char* helpHint = "Run with --help for more information.";

/// A line on standard error, by the way that takes no memory.
void tell(const char* text) noexcept {
    for (const char* part : {"ovphoto: ", text, "\n"}) std::fputs(part, stderr);
}

/// Where an exception cannot be caught, as in the destructors of libraries when memory is gone, or not be told of.
[[noreturn]] void breakOff() noexcept {
    std::set_terminate([] { std::_Exit(exitFailed); });
    std::current_exception() ? tellCurrentException(tell) : tell("broke off");
    removeUnfinishedFiles();
    std::cout.flush();
    std::_Exit(exitFailed);
}

/// Constants of libraries take memory, too, before `main`.
struct Guard {
    Guard() { std::set_terminate(breakOff); }
};
[[gnu::init_priority(101)]] const Guard guard;

/// "300", or with K, M or G behind it: of 1024, its square and its cube.
std::optional<std::uint64_t> parseBytes(std::string_view text) {
    static constexpr std::string_view units = "KMG";
    const std::size_t unit = text.empty() ? units.npos : units.find(text.back());
    const std::size_t shift = unit == units.npos ? 0 : 10 * (unit + 1);
    if (shift > 0) text.remove_suffix(1);
    std::uint64_t number = 0;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    const bool isNumber = error == std::errc() && end == text.data() + text.size();
    return isNumber && number <= UINT64_MAX >> shift ? std::optional(number << shift) : std::nullopt;
}

int parseAndRun(CLI::App& app, std::vector<std::string> arguments) {
    std::string module;
    app.add_option("--module", module, "Load this module instead of the one beside the tool")->type_name("PATH");
    addParsed(app, {"--max-size", "BYTES", "Refuse larger inputs; K, M or G may follow; default 256M"}, parseBytes,
              setLargestInput);
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
            if (!sub->parsed()) continue;
            HostSession session(module);
            session.setVerbose(verbose);
            return action(session);
        }
    } catch (const CLI::ParseError& error) {  // by the session, too: what the module alone can tell of arguments
        return app.exit(error) == 0 ? exitWell : exitUsage;
    }
    complain("A command is required");
    complain(helpHint);
    return exitUsage;
}

int run(std::vector<std::string> arguments) {
    CLI::App app{"Reads, checks and converts photometric files of luminaires; works out the light of sun and sky.",
                 "ovphoto"};
    app.get_formatter()->label("SUBCOMMAND", "COMMAND");
    app.get_formatter()->label("TEXT", "");
    app.footer(
        "Exit status: 0 all well, 1 a file was refused or could not be read or written, 2 wrong usage.\n"
        "Angles are in degrees: theta from the axis, psi around it; latitudes positive towards north, "
        "longitudes,\n"
        "time zones and azimuths (0 is south) towards west.");
    return parseAndRun(app, std::move(arguments));
}

}  // namespace

/// Whatever is thrown ends here as a message.
int main(int argc, char** argv) {
    int status = exitFailed;
    try {
        prepareStandardStreams();
        std::ios::sync_with_stdio(false);
        status = run(commandLine(argc, argv));
    } catch (...) {
        complain("ovphoto: " + currentExceptionText());
    }
    if (std::cout.flush()) return status;
    // Whoever closes a pipe has read enough.
    if (!standardOutputIsClosedPipe()) complain("ovphoto: standard output cannot be written");
    return status == exitWell ? exitFailed : status;
}
