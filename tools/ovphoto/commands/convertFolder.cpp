#include "tools/ovphoto/commands/convertFolder.h"

#include <algorithm>
#include <filesystem>
#include <iostream>
#include <map>
#include <memory>
#include <sstream>

#include "components/support/path.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/conversion.h"
#include "tools/ovphoto/expandPaths.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/progress.h"
#include "tools/ovphoto/selfRunner.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

namespace fs = std::filesystem;

namespace {

/// A file that is to be converted, or why it is not.
struct Job {
    Conversion conversion;
    std::string refusal;
};

struct Plan {
    std::vector<Job> jobs;
    int skipped = 0;  // in folders, of no known format
};

struct ConversionTotals {
    int converted = 0;
    int withWarnings = 0;  // of those
    int failed = 0;
};

/// The place that a path leads to.
fs::path placeOf(const std::string& path) {
    std::error_code error;
    const fs::path native = Ov::nativePath(Ov::fromUtf8(path));
    const fs::path place = fs::weakly_canonical(fs::absolute(native, error), error);
    return place.empty() ? native : place;
}

/// Whether a file that was found in a folder is none of ours.
bool isForeign(const FoundFile& file, const ConvertOptions& options, const HostSession& session) {
    if (!file.fromFolder || !options.as.empty() || session.formats().ofExtension(file.path)) return false;
    std::string error;
    const auto io = openFile(file.path, error);
    return !io || !session.formats().recognise(*io);
}

/// Gives every file its output, and none to two.
class Planner {
public:
    Planner(const ConvertOptions& options, const std::vector<FoundFile>& files) : _options(options) {
        for (const FoundFile& file : files) _inputs.add(file.path);
    }

    Job plan(const FoundFile& file) {
        const fs::path folder = Ov::nativePath(Ov::fromUtf8(_options.folder));
        const std::wstring stem = Ov::pathStem(Ov::fromUtf8(file.path));
        const std::string out = pathText(folder / Ov::nativePath(stem)) + "." + _options.target->extension;
        return {{file.path, out, _options.as, _options.target, _options.asSaved, _options.brief},
                file.error.empty() ? refusal(file.path, out) : file.error};
    }

private:
    std::string refusal(const std::string& in, const std::string& out) {
        const std::string isInput = _inputs.refusal(out);
        if (!isInput.empty()) return out + " " + isInput;
        const auto [taken, isNew] = _outputs.emplace(placeOf(out), in);
        return isNew ? "" : out + " is not written: it is made of " + taken->second;
    }

    const ConvertOptions& _options;
    InputFiles _inputs;
    std::map<fs::path, std::string> _outputs;
};

Plan makePlan(const ConvertOptions& options, const HostSession& session) {
    const std::vector<FoundFile> files = expandPaths(options.paths);
    Planner planner(options, files);
    Plan plan;
    for (const FoundFile& file : files) {
        if (isForeign(file, options, session)) {
            ++plan.skipped;
        } else {
            plan.jobs.push_back(planner.plan(file));
        }
    }
    return plan;
}

/// The arguments with which the tool converts files as this run would; the files are to follow.
std::vector<std::string> argumentsOf(const ConvertOptions& options, const HostSession& session) {
    std::vector<std::string> arguments{
        "convert", "--json",       "--module",   Ov::toUtf8(session.module().path()), "--to", options.target->name,
        "--into",  options.folder, "--max-size", std::to_string(largestInput())};
    if (!options.as.empty()) arguments.insert(arguments.end(), {"--as", options.as});
    if (options.asSaved) arguments.push_back("--as-saved");
    if (options.brief) arguments.push_back("--brief");
    if (session.verbose()) arguments.push_back("--verbose");
    arguments.push_back("--");
    return arguments;
}

/// Carries the jobs out, in this process or in several others, and gives their reports in order.
class Worker {
public:
    Worker(const std::vector<Job>& jobs, const ConvertOptions& options, const HostSession& session)
        : _session(session) {
        if (options.jobs > 1) startProcesses(jobs, options);
    }

    ConversionReport report(const Job& job) {
        if (!job.refusal.empty()) return unconverted(job.conversion, {job.refusal});
        return _runner ? fromProcess(job.conversion) : convertFile(job.conversion, _session);
    }

private:
    /// Each process gets a share of the files: starting one takes longer than a small file.
    void startProcesses(const std::vector<Job>& jobs, const ConvertOptions& options) {
        constexpr std::size_t sharesEach = 4;
        constexpr std::size_t mostFiles = 50;  // so that a system takes that many arguments
        const auto isWell = [](const Job& job) { return job.refusal.empty(); };
        _files = static_cast<std::size_t>(std::count_if(jobs.begin(), jobs.end(), isWell));
        _share = std::clamp<std::size_t>(_files / (options.jobs * sharesEach), 1, mostFiles);
        std::vector<std::vector<std::string>> runs;
        std::size_t files = 0;
        for (const Job& job : jobs) {
            if (!isWell(job)) continue;
            if (files++ % _share == 0) runs.push_back(argumentsOf(options, _session));
            runs.back().push_back(job.conversion.in);
        }
        _runner = std::make_unique<SelfRunner>(std::move(runs), options.jobs);
    }

    ConversionReport fromProcess(const Conversion& conversion) {
        if (_left == 0) takeShare();
        --_left;
        std::string line;
        std::getline(_lines, line);
        if (auto report = reportOf(Json::parse(line, nullptr, false))) return std::move(*report);
        // A process that broke off did so at the first file without a report; the rest of its share is done here.
        if (!_failure.empty()) return unconverted(conversion, {std::exchange(_failure, {})});
        return convertFile(conversion, _session);
    }

    void takeShare() {
        const ProcessResult result = _runner->next();
        _left = std::min(_share, _files);
        _files -= _left;
        _lines = std::istringstream(result.out);
        _failure = result.status == -1 && !result.err.empty() ? result.err : "its process broke off";
    }

    const HostSession& _session;
    std::unique_ptr<SelfRunner> _runner;
    std::size_t _share = 1;
    std::size_t _files = 0;     // of shares that were not yet taken
    std::size_t _left = 0;      // files of the share that was taken last
    std::istringstream _lines;  // their reports
    std::string _failure;
};

ConversionTotals carryOut(const Plan& plan, const ConvertOptions& options, const HostSession& session) {
    ConversionTotals totals;
    Progress progress(plan.jobs.size());
    Worker worker(plan.jobs, options, session);
    for (const Job& job : plan.jobs) {
        if (!std::cout) break;
        progress.next();
        const ConversionReport report = worker.report(job);
        ++(report.ok ? totals.converted : totals.failed);
        if (report.ok && !report.warnings.empty()) ++totals.withWarnings;
        progress.clear();
        printReport(report, options.json);
    }
    return totals;
}

void printSummary(const ConversionTotals& totals, int skipped) {
    const int files = totals.converted + totals.failed;
    std::ostringstream line;
    line << files << (files == 1 ? " file: " : " files: ") << totals.converted << " converted";
    if (totals.withWarnings > 0) line << " (" << totals.withWarnings << " with warnings)";
    line << ", " << totals.failed << " failed";
    if (skipped > 0) line << "; " << skipped << " more of no known format";
    say(line.str());
}

}  // namespace

int convertIntoFolder(const ConvertOptions& options, const HostSession& session) {
    const Plan plan = makePlan(options, session);
    std::error_code error;
    fs::create_directories(Ov::nativePath(Ov::fromUtf8(options.folder)), error);
    if (error) {
        complain(options.folder + ": cannot be made: " + error.message());
        return exitFailed;
    }
    const ConversionTotals totals = carryOut(plan, options, session);
    if (!options.json) printSummary(totals, plan.skipped);
    return totals.failed == 0 ? exitWell : exitFailed;
}

}  // namespace OvTool
