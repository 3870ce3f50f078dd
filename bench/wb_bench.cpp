// How long a TagWB* request call takes to return while the service answers:
// the host's diagram is held for that long, so the call must only start the
// request. Through the host runtime emulator and the reference tag service on
// the private test broker, one request after the other:
//   - TagWBRead of one tag, finished with TagWBFinishRead2;
//   - TagWBWrite2 of one value, finished with TagWBFinishRequestSession.
// Only the request call is on the clock; the wait for the signal and the
// finish are not. The figures are microseconds, not ratios.
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/wb_bench
//
// Without a broker the benchmark says so and does nothing.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <chrono>
#include <cstddef>
#include <cstring>
#include <memory>
#include <string>
#include <vector>

#include "WBHostRuntime.h"
#include "kvveldra/TagWB.h"
#include "support/Ratios.h"
#include "support/ServiceDataRoot.h"
#include "support/TimedCalls.h"

namespace {

namespace Bench = Korvane::Veldra::Bench;
namespace Testing = Korvane::Veldra::Testing;

constexpr uint64_t kInstance = 0;
constexpr uint32_t kInitializeMs = 30000;

// A host string made in the host's memory, freed with the object unless the
// library took it over.
class HostText {
public:
    explicit HostText(const std::string& text)
        : handle_(reinterpret_cast<WBStrHandle>(
              WBNewHandleClr(offsetof(WBStr, str) + text.size() + 1))) {
        (*handle_)->cnt = static_cast<int32_t>(text.size());
        std::memcpy((*handle_)->str, text.data(), text.size());
    }
    ~HostText() { WBDisposeHandle(reinterpret_cast<WBHandle>(handle_)); }
    HostText(const HostText&) = delete;
    HostText& operator=(const HostText&) = delete;
    WBStrHandle* Get() { return &handle_; }

private:
    WBStrHandle handle_;
};

// The text of an error handle the library filled; frees it.
std::string TakeText(WBStrHandle& handle) {
    std::string text;
    if (handle != nullptr && *handle != nullptr && (*handle)->cnt > 0) {
        text.assign(reinterpret_cast<const char*>((*handle)->str),
                    static_cast<size_t>((*handle)->cnt));
    }
    WBDisposeHandle(reinterpret_cast<WBHandle>(handle));
    handle = nullptr;
    return text;
}

// What a request function hands out.
struct Pending {
    uint32_t id = 0;
    uint32_t timeoutMs = 0;
    uint32_t signal = 0;
};

// ---- One private broker, one tag service, instance 0 and one double tag ----

struct Setup {
    Bench::ServiceDataRoot root{"kvveldra-wb-bench"};
    std::unique_ptr<Testing::TagServiceProcess> service;
    bool reserved = false;
    uint32_t tag = 0;
    std::string error;

    Setup() {
        error = root.Error();
        if (!error.empty()) return;
        service = root.StartService();
        WBStrHandle text = nullptr;
        bool created = false;
        if (TagWBReserve(&reserved) != 0 ||
            TagWBInitialize(kInstance, nullptr, kInitializeMs, nullptr, &created, &text) != 0) {
            error = "host set-up failed: " + TakeText(text);
            return;
        }
        error = Open("bench.wb." + std::to_string(getpid()));
    }
    ~Setup() {
        WBStrHandle text = nullptr;
        if (tag != 0) TagWBClose(tag, &text);
        TagWBCloseInstance(kInstance, &text);
        TakeText(text);
        TagWBUnreserve(&reserved);
    }

    // Looks the path up and opens or creates its double tag.
    std::string Open(const std::string& path) {
        HostText name(path);
        WBStrHandle text = nullptr;
        Pending lookup;
        if (TagWBLookupTag(kInstance, name.Get(), &lookup.id, &lookup.timeoutMs, &lookup.signal,
                           &text) != 0) {
            return "lookup failed: " + TakeText(text);
        }
        WBWaitSignal(lookup.signal, lookup.timeoutMs);
        bool found = false;
        Pending create;
        create.id = lookup.id;
        if (TagWBOpenOrCreate(kInstance, name.Get(), 0, &found, &tag, &create.id,
                              &create.timeoutMs, &create.signal, &text) != 0) {
            return "open failed: " + TakeText(text);
        }
        if (found) return std::string();
        WBWaitSignal(create.signal, create.timeoutMs);
        if (TagWBFinishCreate(kInstance, name.Get(), 0, create.id, &tag, &text) != 0) {
            return "create failed: " + TakeText(text);
        }
        return std::string();
    }
};

Setup& Shared() {
    static Setup setup;
    return setup;
}

// Runs start (the request call, on the clock) and finish (the wait and the
// finish, off it) once an iteration; leaves "p50_us" and "p99_us" of the
// request calls. Each gives the text of its failure, or an empty text.
template <typename Start, typename Finish>
void TimedRequests(benchmark::State& state, Start start, Finish finish) {
    using Clock = std::chrono::steady_clock;
    std::vector<double> micros;
    micros.reserve(static_cast<size_t>(state.max_iterations));
    for (auto _ : state) {
        Pending pending;
        const auto begin = Clock::now();
        std::string failure = start(pending);
        const auto end = Clock::now();
        if (failure.empty()) {
            WBWaitSignal(pending.signal, pending.timeoutMs);
            failure = finish(pending);
        }
        if (!failure.empty()) return state.SkipWithError(failure.c_str());
        micros.push_back(std::chrono::duration<double, std::micro>(end - begin).count());
    }
    Bench::PutLatencies(state, micros);
}

void WBRead(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    WBStrHandle text = nullptr;
    WBStrHandle value = nullptr;
    TimedRequests(
        state,
        [&](Pending& pending) {
            return TagWBRead(setup.tag, &pending.id, &pending.timeoutMs, &pending.signal,
                             &text) == 0
                       ? std::string()
                       : "read failed: " + TakeText(text);
        },
        [&](const Pending& pending) {
            WBTimestamp timestamp{};
            WBAggregates2 aggregates{};
            const int32_t status = TagWBFinishRead2(setup.tag, 0, pending.id, &value, &timestamp,
                                                    &aggregates, &text);
            WBDisposeHandle(reinterpret_cast<WBHandle>(aggregates.min));
            WBDisposeHandle(reinterpret_cast<WBHandle>(aggregates.max));
            return status == 0 ? std::string() : "finishing the read failed: " + TakeText(text);
        });
    TakeText(value);
}

void WBWrite(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    // One value, its time left to the service.
    const auto values = reinterpret_cast<WBStrArrayHandle>(WBNewHandleClr(sizeof(WBStrArray)));
    (*values)->dimSize = 1;
    HostText number("1.5");
    (*values)->elt[0] = *number.Get();
    WBStrHandle text = nullptr;
    TimedRequests(
        state,
        [&](Pending& pending) {
            return TagWBWrite2(setup.tag, 0, values, nullptr, &pending.id, &pending.timeoutMs,
                               &pending.signal, &text) == 0
                       ? std::string()
                       : "write failed: " + TakeText(text);
        },
        [&](const Pending& pending) {
            return TagWBFinishRequestSession(setup.tag, pending.id, &text) == 0
                       ? std::string()
                       : "finishing the write failed: " + TakeText(text);
        });
    WBDisposeHandle(reinterpret_cast<WBHandle>(values));
}

BENCHMARK(WBRead)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(WBWrite)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();

}  // namespace

int main(int argc, char** argv) {
    using Korvane::Veldra::Bench::PrintRatio;
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    const auto figures = Korvane::Veldra::Bench::RunWithRatios();
    PrintRatio("TagWBRead call p99, us to return while the service answers",
               figures.Get("WBRead", "p99_us"), 1, "<= 20");
    PrintRatio("TagWBWrite2 call p99, us to return while the service answers",
               figures.Get("WBWrite", "p99_us"), 1, "<= 20");
    PrintRatio("TagWBRead call p50, us to return", figures.Get("WBRead", "p50_us"), 1, "-");
    benchmark::Shutdown();
    return 0;
}
