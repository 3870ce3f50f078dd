// The open of an existing tag by a Client against the reference tag service:
// one lookup round trip, p50 and p99 over the iterations. Starts its own
// kvveldra-tagservice on the private test broker.
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/client_open_bench
//
// Without a broker the benchmark says so and does nothing.
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "support/BrokerEnvironment.h"
#include "support/TagServiceProcess.h"
#include "taglibrary/Client.h"
#include "taglibrary/requests/ConsoleAsyncRequest.h"
#include "support/TimedCalls.h"

namespace {

namespace Tags = Korvane::Veldra::TagLibrary;
using Korvane::Veldra::Testing::TagServiceProcess;

// The whole open as a console caller does it; 0 or the failure's status.
int32_t Open(Tags::Client& client, const std::string& path, std::string& error) {
    auto lookup = std::make_shared<Tags::ConsoleAsyncRequest>();
    uint32_t id = 0, timeoutMs = 0;
    int32_t status = client.OpenTag(path, lookup, id, timeoutMs, error);
    if (status != 0) return status;
    lookup->Wait(timeoutMs);
    auto create = std::make_shared<Tags::ConsoleAsyncRequest>();
    bool found = false;
    std::shared_ptr<Tags::TagData> tag;
    status = client.OpenOrCreateTag(0, path, Tags::TagDataType::Double, create, found, tag, id,
                                    timeoutMs, error);
    if (status != 0 || found) return status;
    create->Wait(timeoutMs);
    return client.FinishCreateTag(0, path, Tags::TagDataType::Double, id, tag, error);
}

void BM_OpenExistingTag(benchmark::State& state) {
    Korvane::Veldra::Testing::BrokerSettings broker;
    std::string error;
    const std::string envFile = Korvane::Veldra::Testing::BrokerEnvironment::EnvFilePath();
    if (!Korvane::Veldra::Testing::LoadBrokerSettings(envFile, broker, error)) {
        state.SkipWithError(("no private broker: " + error).c_str());
        return;
    }
    const std::string root = (std::filesystem::temp_directory_path() /
                              ("kvveldra-open-bench-" + std::to_string(getpid())))
                                 .string();
    Korvane::Veldra::Testing::WriteBrokerDataRoot(broker, root);
    setenv("VELDRA_DATA_DIR", root.c_str(), 1);
    TagServiceProcess::Options options;
    options.dataRoot = root;
    TagServiceProcess service(options);

    auto errors = std::make_shared<Korvane::Veldra::TagIngestion::Errors>();
    errors->initialize();
    Tags::Client client("veldra_master", 5000, false, false, errors);
    const std::string path = "bench.open." + std::to_string(getpid());
    if (Open(client, path, error) != 0) {  // creates the tag
        state.SkipWithError(("cannot create the tag: " + error).c_str());
        return;
    }

    std::vector<double> micros;
    for (auto _ : state) {
        const auto start = std::chrono::steady_clock::now();
        if (Open(client, path, error) != 0) {
            state.SkipWithError(("open failed: " + error).c_str());
            break;
        }
        micros.push_back(
            std::chrono::duration<double, std::micro>(std::chrono::steady_clock::now() - start)
                .count());
    }
    Korvane::Veldra::Bench::PutLatencies(state, micros);
    std::filesystem::remove_all(root);
}

BENCHMARK(BM_OpenExistingTag)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();

}  // namespace

BENCHMARK_MAIN();
