#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <utility>
#include <vector>

// What the tool asks of the operating system; one source file for each.

namespace OvTool {

/// Makes sure that the three standard streams can be told from files opened later, even if the caller closed
/// them, that writing to a closed pipe is an error like any other instead of the end of the process, and that
/// bytes pass as they are.
void prepareStandardStreams();
bool standardErrorIsTerminal();
/// Whether standard output, to which writing has failed, is a pipe that nobody reads any more.
bool standardOutputIsClosedPipe();
/// What `main` was given behind the program's name, in UTF-8; wildcards that a shell has left are expanded.
std::vector<std::string> commandLine(int argc, char** argv);
std::filesystem::path executableFolder();
/// Whether a folder is a link to another.
bool isLink(const std::filesystem::path& folder);
/// File name of the module, "libOVphoto.so".
const char* moduleFileName();

/// How a process ended and what it wrote.
struct ProcessResult {
    int status = -1;  // exit status; -1 when it was not started or did not end by itself
    std::string out;
    std::string err;
};

/// A process that was started.
struct Process;

/// Starts the tool itself with these arguments; raises std::system_error.
std::shared_ptr<Process> startSelf(const std::vector<std::string>& arguments);
/// Waits until one of several processes has ended; its place among them, and its result.
std::pair<std::size_t, ProcessResult> waitForOne(const std::vector<std::shared_ptr<Process>>& processes);

}  // namespace OvTool
