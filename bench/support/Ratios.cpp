#include "support/Ratios.h"

#include <cstdio>

namespace Korvane::Veldra::Bench {
namespace {

// A run's name without the "/min_time:2.000" that a benchmark's own minimum
// time adds to it.
std::string WithoutMinTime(std::string name) {
    const std::size_t start = name.find("/min_time:");
    if (start == std::string::npos) return name;
    const std::size_t end = name.find_first_not_of("0123456789.", start + 10);
    return name.erase(start, end == std::string::npos ? std::string::npos : end - start);
}

// The console's report, with each run's figures kept as well.
class CollectingReporter : public benchmark::ConsoleReporter {
public:
    // Without colours: the ratio lines are read back from the output.
    explicit CollectingReporter(RatioFigures& figures)
        : ConsoleReporter(OO_Tabular), figures_(figures) {}

    void ReportRuns(const std::vector<Run>& runs) override {
        ConsoleReporter::ReportRuns(runs);
        for (const Run& run : runs) {
            if (run.error_occurred) continue;
            // Aggregates keep their suffix ("_median"); plain runs lose their options.
            std::string name = WithoutMinTime(run.benchmark_name());
            if (run.run_type != Run::RT_Aggregate) name = name.substr(0, name.find("/iterations:"));
            figures_.Put(name, "real_time", run.GetAdjustedRealTime());
            figures_.Put(name, "cpu_time", run.GetAdjustedCPUTime());
            for (const auto& [key, counter] : run.counters) figures_.Put(name, key, counter.value);
        }
    }

private:
    RatioFigures& figures_;
};

}  // namespace

double RatioFigures::Get(const std::string& run, const std::string& figure) const {
    const auto found = figures_.find(run);
    if (found == figures_.end()) return 0;
    const auto value = found->second.find(figure);
    return value == found->second.end() ? 0 : value->second;
}

void RatioFigures::Put(const std::string& run, const std::string& figure, double value) {
    figures_[run][figure] = value;
}

RatioFigures RunWithRatios() {
    RatioFigures figures;
    CollectingReporter reporter(figures);
    benchmark::RunSpecifiedBenchmarks(&reporter);
    return figures;
}

void PrintRatio(const std::string& what, double numerator, double denominator,
                const std::string& target) {
    if (numerator > 0 && denominator > 0) {
        std::printf("ratio | %s | %.2f | %s\n", what.c_str(), numerator / denominator,
                    target.c_str());
    } else {
        std::printf("ratio | %s | n/a | %s\n", what.c_str(), target.c_str());
    }
    std::fflush(stdout);
}

}  // namespace Korvane::Veldra::Bench
