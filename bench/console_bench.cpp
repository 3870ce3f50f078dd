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
#include <amqp.h>
#include <amqp_tcp_socket.h>
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <algorithm>
#include <chrono>
#include <cstdio>
#include <filesystem>
#include <functional>
#include <memory>
#include <stdexcept>
#include <string>
#include <vector>

#include "kvveldra/TagConsole.h"
#include "messagebus/amqp/AmqpPropertiesC.h"
#include "messagelibrary/AmqpPropertyMapping.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "support/BrokerEnvironment.h"
#include "support/Ratios.h"
#include "support/TagServiceProcess.h"
#include "taglibrary/exports/ConsoleTime.h"

namespace {

namespace Bus = Korvane::Veldra::MessageBus;
namespace Lib = Korvane::Veldra::VeldraMessageLibrary;
namespace Testing = Korvane::Veldra::Testing;
using Clock = std::chrono::steady_clock;

constexpr int kManySamples = 1000;
constexpr int kReplyTimeoutMs = 10000;

// ---- One private broker, one tag service and one console instance ----

struct Setup {
    Testing::BrokerSettings broker;
    std::string root, exchange = "kvveldra.amqpio.test", error;
    std::unique_ptr<Testing::TagServiceProcess> service;
    uint32_t doubleTag = 0;
    std::string doublePath = "bench.console." + std::to_string(getpid());

    Setup() {
        if (!Testing::LoadBrokerSettings(Testing::BrokerEnvironment::EnvFilePath(), broker,
                                         error)) {
            error = "no private broker: " + error;
            return;
        }
        root = (std::filesystem::temp_directory_path() /
                ("kvveldra-console-bench-" + std::to_string(getpid())))
                   .string();
        Testing::WriteBrokerDataRoot(broker, root);
        setenv("VELDRA_DATA_DIR", root.c_str(), 1);
        Testing::TagServiceProcess::Options options;
        options.dataRoot = root;
        service = std::make_unique<Testing::TagServiceProcess>(options);
        bool reserved = false;
        std::string text;
        if (TagConsoleReserve(&reserved) != 0 ||
            TagConsoleInitialize(0, nullptr, nullptr, nullptr, &text) != 0 ||
            TagConsoleOpen(0, &doublePath, 0, false, &doubleTag, &text) != 0) {
            error = "console set-up failed: " + text;
        }
    }
    ~Setup() {
        std::string text;
        TagConsoleClose(doubleTag, false, &text);
        TagConsoleCloseInstance(0, &text);
        bool reserved = true;
        TagConsoleUnreserve(&reserved);
        service.reset();
        std::filesystem::remove_all(root);
    }
};

Setup& Shared() {
    static Setup setup;
    return setup;
}

// ---- The raw baseline: rabbitmq-c only inside the timed loop ----

void Check(amqp_rpc_reply_t reply, const char* what) {
    if (reply.reply_type != AMQP_RESPONSE_NORMAL) {
        throw std::runtime_error(std::string("rabbitmq-c failed: ") + what);
    }
}

// A connection with a reply queue bound to "Veldra.<name>.#", so that the
// service's answers to ReplyTo <name> arrive on it.
class RawClient {
public:
    RawClient(const Testing::BrokerSettings& broker, const std::string& exchange)
        : state_(amqp_new_connection()),
          exchange_(exchange),
          name_("RawBench" + std::to_string(getpid())) {
        amqp_socket_t* socket = amqp_tcp_socket_new(state_);
        if (socket == nullptr ||
            amqp_socket_open(socket, broker.Host.c_str(), broker.AmqpPort) != 0) {
            amqp_destroy_connection(state_);
            throw std::runtime_error("cannot open a socket to the broker");
        }
        Check(amqp_login(state_, "/", 0, 131072, 0, AMQP_SASL_METHOD_PLAIN, broker.User.c_str(),
                         broker.Password.c_str()),
              "login");
        amqp_channel_open(state_, 1);
        Check(amqp_get_rpc_reply(state_), "channel.open");
        const std::string key = "Veldra." + name_ + ".#";
        amqp_queue_declare(state_, 1, amqp_cstring_bytes(name_.c_str()), 0, 0, 0, 1,
                           amqp_empty_table);
        Check(amqp_get_rpc_reply(state_), "queue.declare");
        amqp_queue_bind(state_, 1, amqp_cstring_bytes(name_.c_str()),
                        amqp_cstring_bytes(exchange.c_str()), amqp_cstring_bytes(key.c_str()),
                        amqp_empty_table);
        Check(amqp_get_rpc_reply(state_), "queue.bind");
        amqp_basic_consume(state_, 1, amqp_cstring_bytes(name_.c_str()), amqp_empty_bytes, 0, 1, 0,
                           amqp_empty_table);
        Check(amqp_get_rpc_reply(state_), "basic.consume");
    }
    ~RawClient() {
        amqp_channel_close(state_, 1, AMQP_REPLY_SUCCESS);
        amqp_connection_close(state_, AMQP_REPLY_SUCCESS);
        amqp_destroy_connection(state_);
    }
    RawClient(const RawClient&) = delete;
    RawClient& operator=(const RawClient&) = delete;

    // The message as the library would send it, answered to this client.
    struct Prepared {
        std::string routingKey;
        std::string body;
        Bus::AmqpProperties properties;
    };
    Prepared Prepare(Bus::MessageBase& message) const {
        message.EnsureIdentity();
        message.SetIgnoreResponse(false);
        message.Headers().SetReplyTo(name_);
        message.Headers().SetOrigin(name_);
        return {message.RoutingKey(), message.Serialize().ToString(),
                Bus::ToAmqpProperties(message.Headers())};
    }

    // Publishes and waits for one reply; one request in flight at a time.
    void RoundTrip(const Prepared& message, const Bus::AmqpBasicProperties& properties) {
        if (amqp_basic_publish(state_, 1, amqp_cstring_bytes(exchange_.c_str()),
                               amqp_cstring_bytes(message.routingKey.c_str()), 0, 0,
                               properties.Get(), amqp_cstring_bytes(message.body.c_str())) != 0) {
            throw std::runtime_error("rabbitmq-c failed: basic.publish");
        }
        amqp_maybe_release_buffers(state_);
        amqp_envelope_t envelope;
        timeval timeout{kReplyTimeoutMs / 1000, 0};
        Check(amqp_consume_message(state_, &envelope, &timeout, 0), "consume");
        amqp_destroy_envelope(&envelope);
    }

private:
    amqp_connection_state_t state_;
    const std::string exchange_;
    const std::string name_;
};

// ---- Timing ----

void Report(benchmark::State& state, std::vector<double>& micros, int64_t valuesPerCall) {
    if (micros.empty()) return;
    std::sort(micros.begin(), micros.end());
    state.counters["p50_us"] = micros[micros.size() / 2];
    state.counters["p99_us"] = micros[std::min(micros.size() - 1, micros.size() * 99 / 100)];
    state.counters["calls_per_s"] =
        benchmark::Counter(static_cast<double>(micros.size()), benchmark::Counter::kIsRate);
    state.counters["values_per_s"] = benchmark::Counter(
        static_cast<double>(micros.size() * valuesPerCall), benchmark::Counter::kIsRate);
}

// Runs call once per iteration; a failing call ends the benchmark.
template <typename Call>
void Timed(benchmark::State& state, int64_t valuesPerCall, Call call) {
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
    Report(state, micros, valuesPerCall);
}

TagConsoleSamples Samples(int count) {
    TagConsoleSamples samples;
    const auto now =
        std::chrono::time_point_cast<std::chrono::microseconds>(std::chrono::system_clock::now());
    for (int i = 0; i < count; ++i) {
        samples.push_back({std::to_string(i) + ".5", now + std::chrono::microseconds(i)});
    }
    return samples;
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
    const TagConsoleSamples samples = Samples(static_cast<int>(state.range(0)));
    std::string error;
    Timed(state, state.range(0), [&] {
        return TagConsoleWriteTag(setup.doubleTag, 0, &samples, false, &error) == 0
                   ? std::string()
                   : "write failed: " + error;
    });
}

void RawWrite(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    RawClient raw(setup.broker, setup.exchange);
    auto message = UpdateOf(setup.doublePath, Samples(static_cast<int>(state.range(0))));
    const auto prepared = raw.Prepare(*message);
    const Bus::AmqpBasicProperties properties(prepared.properties);
    Timed(state, state.range(0), [&] {
        raw.RoundTrip(prepared, properties);
        return std::string();
    });
}

void ConsoleRead(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    const std::vector<uint32_t> references{setup.doubleTag};
    std::vector<TagConsoleValue> values;
    std::string error;
    Timed(state, 1, [&] {
        values.clear();
        return TagConsoleReadValues(0, &references, false, 0, &values, &error) == 0
                   ? std::string()
                   : "read failed: " + error;
    });
}

void RawRead(benchmark::State& state) {
    Setup& setup = Shared();
    if (!setup.error.empty()) return state.SkipWithError(setup.error.c_str());
    RawClient raw(setup.broker, setup.exchange);
    Lib::TagCurrentValueMessages::TagCvQueryCurrentValuesByPathRequest request(
        Lib::JsonStringList{setup.doublePath}, false);
    const auto prepared = raw.Prepare(request);
    const Bus::AmqpBasicProperties properties(prepared.properties);
    Timed(state, 1, [&] {
        raw.RoundTrip(prepared, properties);
        return std::string();
    });
}

BENCHMARK(RawWrite)->Arg(1)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(ConsoleWrite)->Arg(1)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(RawRead)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(ConsoleRead)->Iterations(2000)->Unit(benchmark::kMicrosecond)->UseRealTime();
BENCHMARK(RawWrite)
    ->Arg(kManySamples)
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
               figures.Get("RawWrite/1", "p50_us"), "<= 1.15");
    PrintRatio("TagConsoleReadValues p50 / raw", figures.Get("ConsoleRead", "p50_us"),
               figures.Get("RawRead", "p50_us"), "-");
    const std::string many = "/" + std::to_string(kManySamples);
    PrintRatio("values/s in writes of " + std::to_string(kManySamples) + ", console / raw",
               figures.Get("ConsoleWrite" + many, "values_per_s"),
               figures.Get("RawWrite" + many, "values_per_s"), "-");
    benchmark::Shutdown();
    return 0;
}
