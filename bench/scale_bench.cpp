// How the console's cost grows with the size of the work, through instance 1
// (configuration veldra_master) against the reference tag service:
//   - writes of 10, 1,000 and 100,000 values in one call: time per value;
//   - a listing of 100,000 tags in pages of 1,000: the last page against the
//     first;
//   - 10,000 tags open: resident size per open tag, and the open and close
//     of one more tag against the same with 10 open;
//   - 1, 4 and 16 threads of sequential round trips (a read of one value)
//     through the instance, against raw rabbitmq-c at the same thread counts
//     (a connection a thread, the same request).
// Starts its own kvveldra-tagservice on the private test broker: in memory
// for the values and round trips, then over an SQLite store filled with the
// listed tags before the service starts.
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/scale_bench
//
// KVVELDRA_SCALE_SMALL=1 runs every part at reduced sizes, as a quick check
// that it works; its figures mean little. Without a broker the benchmark says
// so and does nothing.
#include <benchmark/benchmark.h>
#include <malloc.h>

#include <cstdlib>
#include <exception>
#include <memory>
#include <string>
#include <tuple>
#include <vector>

#include "kvveldra/TagConsole.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "support/ConsoleReferences.h"
#include "support/ConsoleSamples.h"
#include "support/PairedTiming.h"
#include "support/Ratios.h"
#include "support/RawServiceClient.h"
#include "support/ResidentSize.h"
#include "support/ScaleWorld.h"
#include "support/ThreadRound.h"
#include "support/TimedCalls.h"

namespace {

namespace Bench = Korvane::Veldra::Bench;
namespace Lib = Korvane::Veldra::VeldraMessageLibrary;
using Bench::RunWarmPaired;
using World = Bench::ScaleWorld;
constexpr uint64_t kInstance = World::kInstance;
constexpr int32_t kDouble = World::kDouble;

// ---- Sizes ----

// The sizes of a run, and how many rounds each part takes.
struct Sizes {
    // Values a write call: (few, some) and (some, many) are timed in turns.
    int fewValues = 10, someValues = 1000, manyValues = 100000;
    int64_t fewRounds = 20, manyRounds = 5;
    // Tags in the store, listed a page at a time.
    int listedTags = 100000, page = 1000;
    int64_t pageRounds = 10;
    // Tags held open: the fewer, then the more; an open and close each round.
    int fewOpen = 10, manyOpen = 10000;
    int64_t openCloses = 500;
    // Threads of round trips; a round shares roundTrips among them.
    std::vector<int> threads{1, 4, 16};
    int roundTrips = 1920;
    int64_t threadRounds = 4;
};

Sizes SmallSizes() {
    Sizes sizes;
    sizes.someValues = 100;
    sizes.manyValues = 10000;
    sizes.fewRounds = 4;
    sizes.manyRounds = 2;
    sizes.listedTags = 5000;
    sizes.page = 100;
    sizes.pageRounds = 4;
    sizes.manyOpen = 1000;
    sizes.openCloses = 100;
    sizes.roundTrips = 320;
    sizes.threadRounds = 2;
    return sizes;
}

std::unique_ptr<World> g_world;

// The shared world at the stage, or null after skipping the benchmark.
World* WorldAt(benchmark::State& state, World::Stage stage) {
    if (!g_world->Enter(stage)) {
        state.SkipWithError(g_world->Error().c_str());
        return nullptr;
    }
    return g_world.get();
}

// ---- The benchmarks ----

// large values in one call (ours) against large / small calls of small
// values (theirs), in turns.
void Writes(benchmark::State& state, int small, int large) {
    World* world = WorldAt(state, World::Stage::Values);
    if (world == nullptr) return;
    const TagConsoleSamples smallSamples = Bench::DoubleSamples(small);
    const TagConsoleSamples largeSamples = Bench::DoubleSamples(large);
    std::string failure;
    const auto write = [&](const TagConsoleSamples& samples, int calls) {
        std::string error;
        for (int i = 0; i < calls && failure.empty(); ++i) {
            if (TagConsoleWriteTag(world->ValueTag(), kDouble, &samples, false, &error) != 0) {
                failure = "write failed: " + error;
            }
        }
    };
    RunWarmPaired(
        state, [&] { write(largeSamples, 1); }, [&] { write(smallSamples, large / small); });
    if (!failure.empty()) return state.SkipWithError(failure.c_str());
    state.counters["ns_per_value_large"] = state.counters["ours_ns"] / large;
    state.counters["ns_per_value_small"] = state.counters["theirs_ns"] / large;
}

// The last page of the listing (ours) against the first (theirs), in turns;
// the pages' references are closed after each, off the clocks.
void ListPages(benchmark::State& state, const Sizes& sizes) {
    World* world = WorldAt(state, World::Stage::Listed);
    if (world == nullptr) return;
    const std::vector<std::string> search{"scale.tag.*"};
    const TagConsoleProperties properties;
    const std::vector<std::string> keywords;
    std::vector<int32_t> types;
    std::vector<std::string> paths;
    std::vector<uint32_t> references;
    std::string failure;
    const auto list = [&](int skip) {
        if (!failure.empty()) return;
        uint32_t total = 0;
        std::string error;
        if (TagConsoleListTag(kInstance, &search, &properties, &keywords,
                              static_cast<uint32_t>(skip), static_cast<uint32_t>(sizes.page), false,
                              false, &types, &paths, &references, &total, &error) != 0) {
            failure = "listing failed: " + error;
        } else if (references.size() != static_cast<size_t>(sizes.page) ||
                   total != static_cast<uint32_t>(sizes.listedTags)) {
            failure = "the listing gave " + std::to_string(references.size()) + " of " +
                      std::to_string(total) + " tags";
        }
    };
    const auto close = [&] {
        Bench::CloseReferences(references);
        references.clear();
    };
    RunWarmPaired(
        state, [&] { list(sizes.listedTags - sizes.page); }, [&] { list(0); }, close);
    if (!failure.empty()) state.SkipWithError(failure.c_str());
}

// Opens listed tags until count are open; the resident size before and after,
// per tag opened, goes to the counter "bytes_per_open_tag".
std::string OpenUpTo(benchmark::State& state, World& world, int count) {
    Bench::ConsoleReferences& opened = world.Opened();
    opened.Reserve(static_cast<size_t>(count));
    const size_t before = opened.Size();
    // Memory that the set-up freed (the store's fill, the listing's pages)
    // would take the new tags without a new page: give it back first, so
    // that the tags' growth shows.
    malloc_trim(0);
    const long beforeKiB = Bench::ResidentKiB();
    std::string error;
    for (size_t i = before; i < static_cast<size_t>(count); ++i) {
        uint32_t reference = 0;
        if (TagConsoleOpen(kInstance, &world.Listed()[i], kDouble, false, &reference, &error) !=
            0) {
            return "open failed: " + error;
        }
        opened.Add(reference);
    }
    if (opened.Size() > before) {
        state.counters["bytes_per_open_tag"] =
            static_cast<double>(Bench::ResidentKiB() - beforeKiB) * 1024.0 /
            static_cast<double>(opened.Size() - before);
    }
    return std::string();
}

// The open and close of one more tag with count tags open on the instance.
void OpenClose(benchmark::State& state, int count) {
    World* world = WorldAt(state, World::Stage::Listed);
    if (world == nullptr) return;
    if (static_cast<size_t>(count) >= world->Listed().size()) {
        return state.SkipWithError("fewer tags listed than are to be open");
    }
    const std::string failure = OpenUpTo(state, *world, count);
    if (!failure.empty()) return state.SkipWithError(failure.c_str());
    const std::string& more = world->Listed().back();
    std::string error;
    Bench::TimedCalls(state, 1, [&] {
        uint32_t reference = 0;
        if (TagConsoleOpen(kInstance, &more, kDouble, false, &reference, &error) != 0 ||
            TagConsoleClose(reference, false, &error) != 0) {
            return "open or close failed: " + error;
        }
        return std::string();
    });
}

// A raw client of the thread's own and the read it sends.
struct RawReader {
    explicit RawReader(const World& world)
        : client(world.Root().Address(), Bench::ServiceDataRoot::kExchange) {
        Lib::TagCurrentValueMessages::TagCvQueryCurrentValuesByPathRequest request(
            Lib::JsonStringList{world.ValuePath()}, false);
        read = client.Prepare(request);
    }
    Bench::RawServiceClient client;
    std::unique_ptr<Bench::RawServiceClient::Prepared> read;
};

// threads threads of sequential reads through the instance (ours) against
// as many raw clients on threads of their own (theirs), in turns; each round
// shares sizes.roundTrips round trips among the threads.
void RoundTrips(benchmark::State& state, const Sizes& sizes, int threads) {
    World* world = WorldAt(state, World::Stage::Values);
    if (world == nullptr) return;
    const int each = sizes.roundTrips / threads;
    std::vector<std::unique_ptr<RawReader>> raws;
    try {
        for (int i = 0; i < threads; ++i) raws.push_back(std::make_unique<RawReader>(*world));
    } catch (const std::exception& error) {
        return state.SkipWithError(error.what());
    }
    const std::vector<uint32_t> references{world->ValueTag()};
    auto console = [&](int) {
        std::vector<TagConsoleValue> values;
        std::string error;
        for (int i = 0; i < each; ++i) {
            values.clear();
            if (TagConsoleReadValues(kInstance, &references, false, 0, &values, &error) != 0) {
                return "read failed: " + error;
            }
        }
        return std::string();
    };
    auto raw = [&](int thread) {
        RawReader& reader = *raws[static_cast<size_t>(thread)];
        for (int i = 0; i < each; ++i) reader.client.RoundTrip(*reader.read);
        return std::string();
    };
    std::string failure;
    const auto run = [&](auto& work) {
        if (failure.empty()) failure = Bench::OnThreads(threads, work);
    };
    RunWarmPaired(
        state, [&] { run(console); }, [&] { run(raw); });
    if (!failure.empty()) return state.SkipWithError(failure.c_str());
    const double perRound = static_cast<double>(each) * threads * 1e9;
    state.counters["instance_per_s"] = perRound / state.counters["ours_ns"];
    state.counters["raw_per_s"] = perRound / state.counters["theirs_ns"];
}

// ---- Registration and the ratios ----

std::string Name(const std::string& stem, const std::vector<int>& numbers) {
    std::string name = stem;
    for (const int number : numbers) name += "/" + std::to_string(number);
    return name;
}

void Register(const Sizes& sizes) {
    const auto add = [](const std::string& name, int64_t iterations, auto run) {
        benchmark::RegisterBenchmark(name.c_str(), run)
            ->Iterations(iterations)
            ->UseRealTime()
            ->Unit(benchmark::kMicrosecond);
    };
    for (const auto& [small, large, rounds] :
         {std::tuple{sizes.fewValues, sizes.someValues, sizes.fewRounds},
          std::tuple{sizes.someValues, sizes.manyValues, sizes.manyRounds}}) {
        add(Name("Writes", {small, large}), rounds,
            [small = small, large = large](benchmark::State& state) {
                Writes(state, small, large);
            });
    }
    for (const int threads : sizes.threads) {
        add(Name("RoundTrips", {threads}), sizes.threadRounds,
            [sizes, threads](benchmark::State& state) { RoundTrips(state, sizes, threads); });
    }
    // The listing first: the open tags would be pages of it.
    add(Name("ListPages", {sizes.listedTags, sizes.page}), sizes.pageRounds,
        [sizes](benchmark::State& state) { ListPages(state, sizes); });
    for (const int count : {sizes.fewOpen, sizes.manyOpen}) {
        add(Name("OpenClose", {count}), sizes.openCloses,
            [count](benchmark::State& state) { OpenClose(state, count); });
    }
}

void PrintRatios(const Bench::RatioFigures& figures, const Sizes& sizes) {
    using Bench::PrintRatio;
    const auto per = [](int number) { return std::to_string(number); };
    const std::string some = Name("Writes", {sizes.someValues, sizes.manyValues});
    const std::string few = Name("Writes", {sizes.fewValues, sizes.someValues});
    PrintRatio(
        "time per value, writes of " + per(sizes.manyValues) + " / of " + per(sizes.someValues),
        figures.Get(some, "ours_ns"), figures.Get(some, "theirs_ns"), "<= 1.2");
    PrintRatio(
        "time per value, writes of " + per(sizes.fewValues) + " / of " + per(sizes.someValues),
        figures.Get(few, "theirs_ns"), figures.Get(few, "ours_ns"), "-");
    const std::string pages = Name("ListPages", {sizes.listedTags, sizes.page});
    PrintRatio(
        "listing " + per(sizes.listedTags) + " tags by " + per(sizes.page) + ", last page / first",
        figures.Get(pages, "ours_ns"), figures.Get(pages, "theirs_ns"), "<= 1.5");
    const std::string manyOpen = Name("OpenClose", {sizes.manyOpen});
    const std::string fewOpen = Name("OpenClose", {sizes.fewOpen});
    PrintRatio("resident bytes per open tag, " + per(sizes.manyOpen) + " open",
               figures.Get(manyOpen, "bytes_per_open_tag"), 1, "<= 1024");
    PrintRatio("open and close of one more tag p50, " + per(sizes.manyOpen) + " / " +
                   per(sizes.fewOpen) + " open",
               figures.Get(manyOpen, "p50_us"), figures.Get(fewOpen, "p50_us"), "<= 1.2");
    for (const int threads : sizes.threads) {
        const std::string run = Name("RoundTrips", {threads});
        PrintRatio("round trips/s, " + per(threads) + (threads == 1 ? " thread" : " threads") +
                       ", instance / raw",
                   figures.Get(run, "instance_per_s"), figures.Get(run, "raw_per_s"), "-");
    }
    const std::string one = Name("RoundTrips", {sizes.threads.front()});
    for (size_t i = 1; i < sizes.threads.size(); ++i) {
        const std::string run = Name("RoundTrips", {sizes.threads[i]});
        for (const char* side : {"instance", "raw"}) {
            const std::string counter = std::string(side) + "_per_s";
            PrintRatio(std::string(side) + " round trips/s, " + per(sizes.threads[i]) + " / " +
                           per(sizes.threads.front()) + " threads",
                       figures.Get(run, counter), figures.Get(one, counter), "-");
        }
    }
}

}  // namespace

int main(int argc, char** argv) {
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    const char* small = std::getenv("KVVELDRA_SCALE_SMALL");
    const Sizes sizes =
        small != nullptr && *small != '\0' && *small != '0' ? SmallSizes() : Sizes();
    Register(sizes);
    g_world = std::make_unique<World>(sizes.listedTags);
    const auto figures = Bench::RunWithRatios();
    PrintRatios(figures, sizes);
    g_world.reset();
    benchmark::Shutdown();
    return 0;
}
