#include <cstdio>
#include <map>

#include "bench/bench.h"
#include "components/photo/lid/component.h"
#include "components/photo/lid/registration.h"
#include "host/componentManager/componentManager.h"

namespace {

/// Keeps the times of a run (the medians, where runs are repeated) and prints the table of ratios.
class RatioReporter : public benchmark::ConsoleReporter {
public:
    void ReportRuns(const std::vector<Run>& runs) override {
        for (const Run& run : runs)
            if (run.aggregate_name.empty() || run.aggregate_name == "median")
                _times[run.run_name.str()] =
                    run.run_name.time_type == "real_time" ? run.GetAdjustedRealTime() : run.GetAdjustedCPUTime();
        ConsoleReporter::ReportRuns(runs);
    }

    void printRatios() {
        std::printf("\n%-60s%10s   wanted\n", "ratio", "measured");
        for (const bench::Ratio& ratio : bench::ratios()) {
            if (!_times.contains(ratio.above) || !_times.contains(ratio.below)) continue;
            const double measured = _times[ratio.above] / _times[ratio.below];
            std::printf("%-60s%10.2f", ratio.what.c_str(), measured);
            if (ratio.atMost > 0)
                std::printf("   %g at most%s", ratio.atMost, measured > ratio.atMost ? ", MISSED" : "");
            if (ratio.atLeast > 0)
                std::printf("   %g at least%s", ratio.atLeast, measured < ratio.atLeast ? ", MISSED" : "");
            std::puts("");
        }
    }

private:
    std::map<std::string, double> _times;
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
