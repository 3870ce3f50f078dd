// Acknowledged writes and queries of the tag service on the private test
// broker. The service (TagServiceEndpoint over a store in memory or an
// SQLite file) and its client run in this process, each with a connection
// manager of its own, as two processes would.
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/tagservice_bench
//
// Without KVVELDRA_BROKER_ENV the file the test harness writes is read
// (<build>/tests/integration/broker/broker.env); without a broker the
// benchmark says so and does nothing.
#include <benchmark/benchmark.h>

#include <cstdio>
#include <memory>
#include <string>
#include <vector>

#include "MemoryTagStore.h"
#include "SqliteTagStore.h"
#include "TagServiceEndpoint.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/HeaderKeys.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "support/BenchBroker.h"
#include "support/ScratchDirectory.h"

namespace {

using namespace Korvane::Veldra;
namespace Tags = VeldraMessageLibrary;
namespace Bus = MessageBus;

constexpr const char* kExchange = "kvveldra.bench.tagservice";
constexpr uint32_t kReplyTimeoutMs = 30000;
constexpr int kQueryTags = 10000;

std::optional<Bench::BrokerAddress> g_broker;

// The service over a fresh store, and a client. One at a time: two services
// on one exchange would both answer.
struct World {
    explicit World(bool onDisk)
        : store(onDisk ? std::unique_ptr<TagService::TagStore>(
                             new TagService::SqliteTagStore(scratch.Path() + "/tags.db"))
                       : std::make_unique<TagService::MemoryTagStore>()),
          logic(*store),
          serviceManager(Bench::MakeManager(*g_broker, kExchange)),
          endpoint(*serviceManager, logic, false),
          clientManager(Bench::MakeManager(*g_broker, kExchange)),
          client(ClientSettings(*clientManager)) {}

    static Bus::MessageServiceSettings ClientSettings(Bus::AmqpConnectionManager& manager) {
        Bus::MessageServiceSettings settings;
        settings.Name = "tagservice_bench_client";
        settings.ConnectionManager = &manager;
        return settings;
    }
    void Create(const std::string& path) {
        const Tags::TagRecord record{path, Tags::TagDataType::Double, std::nullopt, std::nullopt,
                                     true};
        logic.CreateTag(Tags::TagInfoMessages::TagInfoCreateTagRoutedMessage(record));
    }

    Testing::ScratchDirectory scratch{"kvts-bench"};
    std::unique_ptr<TagService::TagStore> store;
    TagService::TagServiceLogic logic;
    std::unique_ptr<Bus::AmqpConnectionManager> serviceManager;
    TagService::TagServiceEndpoint endpoint;
    std::unique_ptr<Bus::AmqpConnectionManager> clientManager;
    Bus::MessageService client;
};

bool Failed(const std::shared_ptr<Bus::GenericMessage>& reply) {
    return reply == nullptr || reply->GetHeader(Bus::HeaderKeys::kErrorCode) != nullptr;
}

// One message of range(1) samples a round, each acknowledged before the
// next is sent; range(0) 1 keeps the tags in SQLite, 0 in memory.
void BM_AcknowledgedWrites(benchmark::State& state) {
    World world(state.range(0) == 1);
    world.Create("bench.write");
    const auto samplesPerMessage = static_cast<std::size_t>(state.range(1));
    std::vector<Tags::TagValueSample> samples;
    for (std::size_t i = 0; i < samplesPerMessage; ++i) {
        samples.push_back(Tags::TagValueSample{
            Tags::Timestamp(), Tags::TagValue{Tags::TagDataType::Double, std::to_string(i * 0.5)}});
    }
    for (auto _ : state) {
        Tags::TagIngestionMessages::TagUpdateValuesRoutedMessage write(
            std::vector<Tags::TagPathUpdates>{{std::string("bench.write"), samples}});
        if (Failed(world.client.SendRequestExpectingResponse(write, kReplyTimeoutMs))) {
            state.SkipWithError("a write was not acknowledged");
            return;
        }
    }
    state.counters["writes_per_s"] =
        benchmark::Counter(static_cast<double>(state.iterations()), benchmark::Counter::kIsRate);
    state.counters["samples_per_s"] = benchmark::Counter(
        static_cast<double>(state.iterations() * samplesPerMessage), benchmark::Counter::kIsRate);
}

// Queries on 10,000 tags in memory: range(0) 0 asks for one path, 1 for a
// page of 100 in the middle of a wildcard's matches.
void BM_Query(benchmark::State& state) {
    World world(false);
    char path[32];
    for (int i = 0; i < kQueryTags; ++i) {
        std::snprintf(path, sizeof path, "bench.query.%05d", i);
        world.Create(path);
    }
    const bool page = state.range(0) == 1;
    const Tags::JsonStringList search{page ? "bench.query.*" : "bench.query.05000"};
    const std::size_t expected = page ? 100 : 1;
    for (auto _ : state) {
        Tags::TagInfoMessages::TagInfoQueryTagsRequest query(search, std::nullopt, std::nullopt,
                                                             page ? 5000 : 0, page ? 100 : 0, true);
        const auto reply = world.client.SendRequest(query, kReplyTimeoutMs);
        if (Failed(reply)) {
            state.SkipWithError("a query was not answered");
            return;
        }
        const Tags::TagInfoMessages::TagInfoQueryTagsResponse response(reply->Headers(),
                                                                       reply->Body());
        if (!response.Tags() || response.Tags()->size() != expected) {
            state.SkipWithError("a query found the wrong tags");
            return;
        }
    }
    state.counters["queries_per_s"] =
        benchmark::Counter(static_cast<double>(state.iterations()), benchmark::Counter::kIsRate);
}

BENCHMARK(BM_AcknowledgedWrites)
    ->ArgNames({"sqlite", "samples"})
    ->Args({0, 1})
    ->Args({0, 1000})
    ->Args({1, 1})
    ->Args({1, 1000})
    ->MinTime(2.0)
    ->UseRealTime()
    ->Unit(benchmark::kMillisecond);
BENCHMARK(BM_Query)->ArgNames({"page"})->Arg(0)->Arg(1)->MinTime(2.0)->UseRealTime()->Unit(
    benchmark::kMillisecond);

}  // namespace

int main(int argc, char** argv) {
    g_broker = Bench::BrokerOrSkip("tagservice_bench");
    if (!g_broker) return 0;
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    benchmark::RunSpecifiedBenchmarks();
    benchmark::Shutdown();
    return 0;
}
