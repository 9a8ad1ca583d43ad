#include <cstdio>
#include <map>

#include "bench/bench.h"
#include "components/module/registration.h"
#include "components/photo/lid/component.h"
#include "host/componentManager/componentManager.h"

namespace {

/// Keeps the times of a run (the medians, where runs are repeated) and prints the table of ratios.
class RatioReporter : public benchmark::ConsoleReporter {
public:
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const Run& run : runs)
            if (run.aggregate_name.empty() || run.aggregate_name == "median")
                _results[run.run_name.str()] = resultOf(run);
        ConsoleReporter::ReportRuns(runs);
    }

    void printRatios() {
        std::printf("\n%-60s%10s   wanted\n", "ratio", "measured");
        for (const bench::Ratio& ratio : bench::ratios()) {
            if (!_results.contains(ratio.ours) || !_results.contains(ratio.floor)) continue;
            const double measured = _results[ratio.ours] / _results[ratio.floor];
            std::printf("%-60s%10.2f", ratio.what.c_str(), measured);
            if (ratio.atMost > 0)
                std::printf("   %g at most%s", ratio.atMost, measured > ratio.atMost ? ", MISSED" : "");
            if (ratio.atLeast > 0)
                std::printf("   %g at least%s", ratio.atLeast, measured < ratio.atLeast ? ", MISSED" : "");
            std::puts("");
        }
    }

private:
    /// The rate, or the time where no bytes are counted.
    static double resultOf(const Run& run) {
        const auto rate = run.counters.find("bytes_per_second");
        if (rate != run.counters.end()) return rate->second;
        return run.run_name.time_type == "manual_time" ? run.GetAdjustedRealTime() : run.GetAdjustedCPUTime();
    }

    std::map<std::string, double> _results;
};

}  // namespace

int main(int argc, char** argv) {
    OvPhotometrics::registerBuilders();
    Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager())->addRegistry(OvPhotometrics::lidComponent());
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 2;
    RatioReporter reporter;
    benchmark::RunSpecifiedBenchmarks(&reporter);
    reporter.printRatios();
}
