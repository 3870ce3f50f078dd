#pragma once

#include <benchmark/benchmark.h>

#include <chrono>
#include <cstdint>

namespace Korvane::Veldra::Bench {

// Times two pieces of work in turns within one benchmark, each on its own
// clock, and leaves their mean times per iteration in the counters "ours_ns"
// and "theirs_ns". On a shared virtual machine the speed of the same code
// drifts by a third within a minute; two benchmarks run one after the other
// see different machines, and their ratio swings with it. Taken in turns,
// the drift falls on both alike. The order alternates, so that neither always
// finds the caches as the other left them.
template <typename Ours, typename Theirs>
void RunPaired(benchmark::State& state, Ours&& ours, Theirs&& theirs) {
    using Clock = std::chrono::steady_clock;
    Clock::duration oursTotal{};
    Clock::duration theirsTotal{};
    bool oursFirst = true;
    for (auto _ : state) {
        const auto timed = [](auto& work, Clock::duration& total) {
            const Clock::time_point start = Clock::now();
            work();
            total += Clock::now() - start;
        };
        if (oursFirst) {
            timed(ours, oursTotal);
            timed(theirs, theirsTotal);
        } else {
            timed(theirs, theirsTotal);
            timed(ours, oursTotal);
        }
        oursFirst = !oursFirst;
    }
    const auto perIteration = [&](Clock::duration total) {
        return static_cast<double>(std::chrono::duration_cast<std::chrono::nanoseconds>(total).count()) /
               static_cast<double>(state.iterations());
    };
    state.counters["ours_ns"] = perIteration(oursTotal);
    state.counters["theirs_ns"] = perIteration(theirsTotal);
}

}  // namespace Korvane::Veldra::Bench
