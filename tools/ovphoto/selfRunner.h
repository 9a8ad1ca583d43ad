#pragma once

#include "tools/ovphoto/platform.h"

namespace OvTool {

/// The tool itself, run once for each list of arguments, up to `atOnce` processes at a time. Waits for those that are
/// under way when it goes.
class SelfRunner {
public:
    SelfRunner(std::vector<std::vector<std::string>> runs, std::size_t atOnce);
    SelfRunner(const SelfRunner&) = delete;
    SelfRunner& operator=(const SelfRunner&) = delete;

    /// The result of the next list of arguments, in their order; there must be one.
    ProcessResult next();

private:
    bool isRunning(std::size_t run) const;
    void startMore();
    void endOne();

    std::vector<std::vector<std::string>> _arguments;
    std::vector<ProcessResult> _results;
    std::vector<std::shared_ptr<Process>> _processes;
    std::vector<std::size_t> _runs;  // of the processes
    std::size_t _atOnce;
    std::size_t _started = 0;
    std::size_t _next = 0;
};

}  // namespace OvTool
