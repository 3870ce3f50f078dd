#pragma once

#include <benchmark/benchmark.h>

#include <algorithm>
#include <chrono>
#include <cstdint>
#include <string>
#include <vector>

namespace Korvane::Veldra::Bench {

// Sorts the times of the calls, in microseconds, and leaves their "p50_us"
// and "p99_us" counters; nothing without times.
inline void PutLatencies(benchmark::State& state, std::vector<double>& micros) {
    if (micros.empty()) return;
    std::sort(micros.begin(), micros.end());
    state.counters["p50_us"] = micros[micros.size() / 2];
    state.counters["p99_us"] = micros[std::min(micros.size() - 1, micros.size() * 99 / 100)];
}

// Runs call once an iteration, each on its own clock, and leaves the
// counters "p50_us" and "p99_us" of the calls, "calls_per_s" and
// "values_per_s" (valuesPerCall a call). call gives the text of its failure,
// or an empty text; a failing call ends the benchmark.
template <typename Call>
void TimedCalls(benchmark::State& state, int64_t valuesPerCall, Call call) {
    using Clock = std::chrono::steady_clock;
    std::vector<double> micros;
    micros.reserve(static_cast<size_t>(state.max_iterations));
    for (auto _ : state) {
        const auto start = Clock::now();
        const std::string failure = call();
        if (!failure.empty()) {
            state.SkipWithError(failure.c_str());
            return;
        }
        micros.push_back(std::chrono::duration<double, std::micro>(Clock::now() - start).count());
    }
    if (micros.empty()) return;
    PutLatencies(state, micros);
    state.counters["calls_per_s"] =
        benchmark::Counter(static_cast<double>(micros.size()), benchmark::Counter::kIsRate);
    state.counters["values_per_s"] =
        benchmark::Counter(static_cast<double>(micros.size()) * static_cast<double>(valuesPerCall),
                           benchmark::Counter::kIsRate);
}

}  // namespace Korvane::Veldra::Bench
