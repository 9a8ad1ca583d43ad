#pragma once

#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <system_error>
#include <utility>
#include <vector>

// What the tool asks of the operating system; one source file for each.

namespace OvTool {

/// Makes sure that the three standard streams can be told from files opened later, even if the caller closed
/// them, that writing to a closed pipe or beyond the largest size of files is an error like any other instead of the
/// end of the process, and that bytes pass as they are.
void prepareStandardStreams();
bool standardErrorIsTerminal();
/// Whether standard output, to which writing has failed, is a pipe that nobody reads any more.
bool standardOutputIsClosedPipe();
/// What `main` was given behind the program's name, in UTF-8; wildcards that a shell has left are expanded.
std::vector<std::string> commandLine(int argc, char** argv);
std::filesystem::path executableFolder();
/// The paths of what stands in a folder, by name; where it cannot be listed, of what was found by then, and why.
std::vector<std::filesystem::path> pathsIn(const std::filesystem::path& folder, std::error_code& error);
/// Whether a folder is a link to another.
bool isLink(const std::filesystem::path& folder);
/// File name of the module, "libOVphoto.so".
const char* moduleFileName();

/// Tells a file from all others, whatever it is called: the volume and a number there.
using FileIdentity = std::pair<std::uint64_t, std::uint64_t>;
/// Of what a path leads to, links followed; none where there is nothing.
std::optional<FileIdentity> identityOf(const std::filesystem::path& file);
/// Whether a file that is there may be written.
bool isWritable(const std::filesystem::path& file);
/// Writes a file, which must not be there yet, and waits until the disk holds it.
std::error_code writeNewFile(const std::filesystem::path& file, std::string_view bytes);
/// Waits until the disk holds the names in a folder.
std::error_code syncFolder(const std::filesystem::path& folder);

/// While it lives, signals that end the process wait, for this thread and those that it starts. Of one thread.
class SignalsHeld {
public:
    SignalsHeld() { hold(); }
    SignalsHeld(const SignalsHeld&) = delete;
    SignalsHeld& operator=(const SignalsHeld&) = delete;
    ~SignalsHeld() { release(); }

private:
    static void hold();
    static void release();
};

/// From now on `work` runs before a signal ends the process, while no signal is held. It must call nothing but
/// `removeAtOnce`.
void runBeforeEnd(void (*work)());
/// Removes a file, in a process that a signal ends.
void removeAtOnce(const std::filesystem::path& file) noexcept;

/// How a process ended and what it wrote.
struct ProcessResult {
    int status = -1;  // exit status; -1 when it was not started or did not end by itself
    std::string out;
    std::string err;
};

/// A process that was started; waited for when it goes.
struct Process;

/// Starts the tool itself with these arguments; raises std::system_error.
std::shared_ptr<Process> startSelf(const std::vector<std::string>& arguments);
/// Waits until one of several processes has ended; its place among them, and its result.
std::pair<std::size_t, ProcessResult> waitForOne(const std::vector<std::shared_ptr<Process>>& processes);

}  // namespace OvTool
