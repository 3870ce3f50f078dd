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
// finds the caches as the other left them. tidy, when given, runs after
// each piece of work off both clocks (to put back what the work changed).
template <typename Ours, typename Theirs, typename Tidy>
void RunPaired(benchmark::State& state, Ours&& ours, Theirs&& theirs, Tidy&& tidy) {
    using Clock = std::chrono::steady_clock;
    Clock::duration oursTotal{};
    Clock::duration theirsTotal{};
    bool oursFirst = true;
    for (auto _ : state) {
        const auto timed = [&tidy](auto& work, Clock::duration& total) {
            const Clock::time_point start = Clock::now();
            work();
            total += Clock::now() - start;
            tidy();
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

template <typename Ours, typename Theirs>
void RunPaired(benchmark::State& state, Ours&& ours, Theirs&& theirs) {
    RunPaired(state, ours, theirs, [] {});
}

// RunPaired after one untimed run of each piece: the first of a kind (a
// service's first query after its start, a connection's first request) can
// cost many times the rest, and would fall on one side only.
template <typename Ours, typename Theirs, typename Tidy>
void RunWarmPaired(benchmark::State& state, Ours&& ours, Theirs&& theirs, Tidy&& tidy) {
    ours();
    tidy();
    theirs();
    tidy();
    RunPaired(state, ours, theirs, tidy);
}

template <typename Ours, typename Theirs>
void RunWarmPaired(benchmark::State& state, Ours&& ours, Theirs&& theirs) {
    RunWarmPaired(state, ours, theirs, [] {});
}

}  // namespace Korvane::Veldra::Bench
