#pragma once

#include <filesystem>
#include <memory>
#include <string>
#include <vector>

// What the tool asks of the operating system; one source file for each.

namespace OvTool {

/// Makes sure that the three standard streams can be told from files opened later, even if the caller closed
/// them, and that writing to a closed pipe is an error like any other instead of the end of the process.
void prepareStandardStreams();
bool standardErrorIsTerminal();
std::filesystem::path executableFolder();
/// File name of the module, "libOVphoto.so".
const char* moduleFileName();

/// How a process ended and what it wrote.
struct ProcessResult {
    int status = -1;  // exit status; -1 when it was not started or did not end by itself
    std::string out;
    std::string err;
};

/// The tool itself, run once for each list of arguments, up to `atOnce` processes at a time.
class SelfRunner {
public:
    SelfRunner(std::vector<std::vector<std::string>> runs, std::size_t atOnce);
    SelfRunner(const SelfRunner&) = delete;
    SelfRunner& operator=(const SelfRunner&) = delete;
    /// Waits for the processes that are under way.
    ~SelfRunner();

    /// The result of the next list of arguments, in their order; there must be one.
    ProcessResult next();

private:
    class Processes;
    std::unique_ptr<Processes> _processes;
};

}  // namespace OvTool
