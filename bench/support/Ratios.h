#pragma once

#include <benchmark/benchmark.h>

#include <map>
#include <string>
#include <vector>

// The figures of one benchmark run, kept for the ratios printed after it.
//
// A benchmark's main runs its benchmarks through RunWithRatios and then
// prints each ratio with PrintRatio. A ratio line reads
//
//     ratio | <what> | <value> | <target>
//
// which scripts/bench.sh gathers into its table. A ratio whose figures are
// missing (a benchmark skipped or failed) is printed as "n/a".
namespace Korvane::Veldra::Bench {

class RatioFigures {
public:
    // A figure of the run named run (its name as the console shows it, up to
    // the first "/" of options such as "/iterations:"), or 0 when absent:
    // "real_time", "cpu_time" (in the run's time unit), "bytes_per_second",
    // "items_per_second" or a user counter.
    double Get(const std::string& run, const std::string& figure) const;
    void Put(const std::string& run, const std::string& figure, double value);

private:
    std::map<std::string, std::map<std::string, double>> figures_;
};

// Runs the benchmarks that the command line selects, with the console's
// output, and collects their figures.
RatioFigures RunWithRatios();

// Prints "ratio | what | numerator/denominator | target".
void PrintRatio(const std::string& what, double numerator, double denominator,
                const std::string& target);

}  // namespace Korvane::Veldra::Bench
