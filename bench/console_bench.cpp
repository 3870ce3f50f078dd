// The console functions against the reference tag service, each beside a raw
// rabbitmq-c baseline in the same run that publishes the same body to the
// same service and waits for its reply:
//   - TagConsoleWriteTag of one value: p50, p99, round trips per second;
//   - TagConsoleReadValues of one tag: the same figures;
//   - values per second through writes of many samples.
// Starts its own kvveldra-tagservice (in memory) on the private test broker.
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/console_bench
//
// Without a broker the benchmark says so and does nothing.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <memory>
#include <string>
#include <vector>

#include "kvveldra/TagConsole.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "support/ConsoleInstance.h"
#include "support/ConsoleSamples.h"
#include "support/Ratios.h"
#include "support/RawServiceClient.h"
#include "support/ServiceDataRoot.h"
#include "support/TimedCalls.h"
#include "taglibrary/exports/ConsoleTime.h"

namespace {

namespace Bench = Korvane::Veldra::Bench;
namespace Lib = Korvane::Veldra::VeldraMessageLibrary;
namespace Testing = Korvane::Veldra::Testing;
using Bench::DoubleSamples;
using Bench::TimedCalls;

constexpr int kManySamples = 1000;

// ---- One private broker, one tag service and one console instance ----

struct Setup {
    Bench::ServiceDataRoot root{"kvveldra-console-bench"};
    std::unique_ptr<Testing::TagServiceProcess> service;
    std::unique_ptr<Bench::ConsoleInstance> console;
    std::string error;
    uint32_t doubleTag = 0;
    std::string doublePath = "bench.console." + std::to_string(getpid());

    Setup() {
        error = root.Error();
        if (!error.empty()) return;
        service = root.StartService();
        console = std::make_unique<Bench::ConsoleInstance>(0);
        error = console->Error();
        std::string text;
        if (error.empty() && TagConsoleOpen(0, &doublePath, 0, false, &doubleTag, &text) != 0) {
            error = "console set-up failed: " + text;
        }
    }
    ~Setup() {
        std::string text;
        if (doubleTag != 0) TagConsoleClose(doubleTag, false, &text);
    }
};

Setup& Shared() {
    static Setup setup;
    return setup;
}

// A raw client on the broker and exchange of the service.
std::unique_ptr<Bench::RawServiceClient> RawClient(const Setup& setup, bool handOff = false) {
    return std::make_unique<Bench::RawServiceClient>(setup.root.Address(),
                                                     Bench::ServiceDataRoot::kExchange, handOff);
}

// The body the console write sends for the same samples.
std::unique_ptr<Lib::TagIngestionMessages::TagUpdateValuesRoutedMessage> UpdateOf(
    const std::string& path, const TagConsoleSamples& samples) {
    std::vector<Lib::TagValueSample> values;
    for (const auto& sample : samples) {
        Lib::TagValueSample value;
        value.timestamp = Korvane::Veldra::TagLibrary::ConsoleTimeToTimestamp(sample.timestamp);
        value.value = Lib::TagValue{Lib::TagDataType::Double, sample.value};
        values.push_back(std::move(value));
    }
    std::vector<Lib::TagPathUpdates> updates{{path, std::move(values)}};
    return std::make_unique<Lib::TagIngestionMessages::TagUpdateValuesRoutedMessage>(
        std::move(updates));
}

// ---- The benchmarks ----

void ConsoleWrite(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    const TagConsoleSamples samples = DoubleSamples(static_cast<int>(state.range(0)));
    std::string error;
    TimedCalls(state, state.range(0), [&] {
        return TagConsoleWriteTag(setup.doubleTag, 0, &samples, false, &error) == 0
                   ? std::string()
                   : "write failed: " + error;
    });
}

// Argument 1 set: the raw client in the library's shape, its replies read by
// a thread of its own and handed to the caller.
void RawWrite(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    const auto raw = RawClient(setup, state.range(1) != 0);
    auto message = UpdateOf(setup.doublePath, DoubleSamples(static_cast<int>(state.range(0))));
    const auto prepared = raw->Prepare(*message);
    TimedCalls(state, state.range(0), [&] {
        raw->RoundTrip(*prepared);
        return std::string();
    });
}

void ConsoleRead(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    const std::vector<uint32_t> references{setup.doubleTag};
    std::vector<TagConsoleValue> values;
    std::string error;
    TimedCalls(state, 1, [&] {
        values.clear();
        return TagConsoleReadValues(0, &references, false, 0, &values, &error) == 0
                   ? std::string()
                   : "read failed: " + error;
    });
}

void RawRead(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    const auto raw = RawClient(setup);
    Lib::TagCurrentValueMessages::TagCvQueryCurrentValuesByPathRequest request(
        Lib::JsonStringList{setup.doublePath}, false);
    const auto prepared = raw->Prepare(request);
    TimedCalls(state, 1, [&] {
        raw->RoundTrip(*prepared);
        return std::string();
    });
}

BENCHMARK(RawWrite)
    ->Args({1, 0})
    ->Args({1, 1})
    ->Iterations(2000)
    ->Unit(benchmark::kMicrosecond)
    ->UseRealTime();
BENCHMARK(ConsoleWrite)->Arg(1)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(RawRead)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(ConsoleRead)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(RawWrite)
    ->Args({kManySamples, 0})
    ->Args({kManySamples, 1})
    ->Iterations(200)
    ->Unit(benchmark::kMicrosecond)
    ->UseRealTime();
BENCHMARK(ConsoleWrite)
    ->Arg(kManySamples)
    ->Iterations(200)
    ->Unit(benchmark::kMicrosecond)
    ->UseRealTime();

}  // namespace

int main(int argc, char** argv) {
    using Korvane::Veldra::Bench::PrintRatio;
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    const auto figures = Korvane::Veldra::Bench::RunWithRatios();
    PrintRatio("TagConsoleWriteTag p50 / raw", figures.Get("ConsoleWrite/1", "p50_us"),
               figures.Get("RawWrite/1/0", "p50_us"), "<= 1.10");
    PrintRatio("raw write p50, raw in the library's shape / raw",
               figures.Get("RawWrite/1/1", "p50_us"), figures.Get("RawWrite/1/0", "p50_us"), "-");
    PrintRatio("TagConsoleReadValues p50 / raw", figures.Get("ConsoleRead", "p50_us"),
               figures.Get("RawRead", "p50_us"), "-");
    const std::string many = "/" + std::to_string(kManySamples);
    PrintRatio("values/s in writes of " + std::to_string(kManySamples) + ", console / raw",
               figures.Get("ConsoleWrite" + many, "values_per_s"),
               figures.Get("RawWrite" + many + "/0", "values_per_s"), ">= 0.95");
    PrintRatio("values/s in writes of " + std::to_string(kManySamples) +
                   ", raw in the library's shape / raw",
               figures.Get("RawWrite" + many + "/1", "values_per_s"),
               figures.Get("RawWrite" + many + "/0", "values_per_s"), "-");
    benchmark::Shutdown();
    return 0;
}
