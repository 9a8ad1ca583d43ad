#include "tools/ovphoto/selfRunner.h"

#include <algorithm>
#include <system_error>

namespace OvTool {

SelfRunner::SelfRunner(std::vector<std::vector<std::string>> runs, std::size_t atOnce)
    : _arguments(std::move(runs)), _results(_arguments.size()), _atOnce(atOnce) {}

ProcessResult SelfRunner::next() {
    const std::size_t run = _next++;
    startMore();
    while (isRunning(run)) {
        endOne();
        startMore();
    }
    return std::move(_results[run]);
}

bool SelfRunner::isRunning(std::size_t run) const {
    return std::find(_runs.begin(), _runs.end(), run) != _runs.end();
}

void SelfRunner::startMore() {
    for (; _processes.size() < _atOnce && _started < _arguments.size(); ++_started) {
        try {
            _processes.push_back(startSelf(_arguments[_started]));
            _runs.push_back(_started);
        } catch (const std::system_error& error) {
            _results[_started].err = "no process can be started: " + error.code().message();
        }
    }
}

void SelfRunner::endOne() {
    auto [place, result] = waitForOne(_processes);
    _results[_runs[place]] = std::move(result);
    _processes.erase(_processes.begin() + static_cast<std::ptrdiff_t>(place));
    _runs.erase(_runs.begin() + static_cast<std::ptrdiff_t>(place));
}

}  // namespace OvTool
