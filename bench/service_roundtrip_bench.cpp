// Round trip of a small request answered by a minimal responder, through
// MessageService and directly on rabbitmq-c, on the private test broker. The
// raw baseline runs twice: with the same properties and header table as
// MessageService puts on the wire (the baseline of the ratios' targets), and
// with a minimal message, which shows what the header table costs the broker.
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/service_roundtrip_bench
//
// Without KVVELDRA_BROKER_ENV the file the test harness writes next to the
// build's benchmarks (tests/integration/broker/broker.env) is read; without a
// broker the benchmark says so and does nothing.
#include <amqp.h>
#include <benchmark/benchmark.h>
#include <unistd.h>

#include <algorithm>
#include <atomic>
#include <chrono>
#include <cstdio>
#include <fstream>
#include <map>
#include <memory>
#include <mutex>
#include <optional>
#include <stdexcept>
#include <string>
#include <thread>
#include <vector>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/amqp/AmqpPropertiesC.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/concurrency/SharedQueue.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/AmqpPropertyMapping.h"
#include "messagelibrary/RequestMessage.h"
#include "support/BenchBroker.h"
#include "support/BenchServices.h"
#include "support/Ratios.h"
#include "support/RawAmqp.h"

namespace {

namespace Bus = Korvane::Veldra::MessageBus;
using Clock = std::chrono::steady_clock;

constexpr int kSequentialRoundTrips = 3000;
constexpr int kPipelineThreads = 4;
constexpr int kPipelineWindow = 32;  // requests in flight per thread
constexpr int kPipelinePerThread = 5000;
constexpr int kReplyTimeoutMs = 5000;

using Korvane::Veldra::Bench::AnsweringResponder;
using Korvane::Veldra::Bench::BrokerAddress;
using Korvane::Veldra::Bench::BrokerOrSkip;
using Korvane::Veldra::Bench::CheckRawReply;
using Korvane::Veldra::Bench::CloseRawConnection;
using Korvane::Veldra::Bench::OpenRawConnection;
using Korvane::Veldra::Bench::ServiceSettings;

// ---- Directly on rabbitmq-c ----

std::string Text(const amqp_bytes_t& bytes) {
    return std::string(static_cast<const char*>(bytes.bytes), bytes.len);
}

struct Delivery {
    std::string correlationId, replyTo;
};

// One connection with channel 1, used by one thread at a time.
class RawConnection {
public:
    explicit RawConnection(const BrokerAddress& broker) : state_(OpenRawConnection(broker)) {}
    ~RawConnection() { CloseRawConnection(state_); }
    RawConnection(const RawConnection&) = delete;
    RawConnection& operator=(const RawConnection&) = delete;

    // A topic exchange, and an auto-deleted queue bound to it with the key
    // and consumed without acknowledgements.
    void Listen(const std::string& exchange, const std::string& queue, const std::string& key) {
        amqp_exchange_declare(state_, 1, amqp_cstring_bytes(exchange.c_str()),
                              amqp_cstring_bytes("topic"), 0, 0, 0, 0, amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "exchange.declare");
        amqp_queue_declare(state_, 1, amqp_cstring_bytes(queue.c_str()), 0, 0, 0, 1,
                           amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "queue.declare");
        amqp_queue_bind(state_, 1, amqp_cstring_bytes(queue.c_str()),
                        amqp_cstring_bytes(exchange.c_str()), amqp_cstring_bytes(key.c_str()),
                        amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "queue.bind");
        amqp_basic_consume(state_, 1, amqp_cstring_bytes(queue.c_str()), amqp_empty_bytes, 0, 1, 0,
                           amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "basic.consume");
    }

    // With base, its properties go out (header table included), with this
    // correlation id and reply-to; without, only content type, correlation id
    // and reply-to.
    void Publish(const std::string& exchange, const std::string& key,
                 const std::string& correlationId, const std::string& replyTo,
                 const amqp_basic_properties_t* base = nullptr) {
        amqp_basic_properties_t properties{};
        if (base != nullptr) properties = *base;
        properties._flags |= AMQP_BASIC_CONTENT_TYPE_FLAG | AMQP_BASIC_CORRELATION_ID_FLAG |
                             AMQP_BASIC_REPLY_TO_FLAG;
        if (base == nullptr) properties.content_type = amqp_cstring_bytes("application/json");
        properties.correlation_id = amqp_cstring_bytes(correlationId.c_str());
        properties.reply_to = amqp_cstring_bytes(replyTo.c_str());
        if (amqp_basic_publish(state_, 1, amqp_cstring_bytes(exchange.c_str()),
                               amqp_cstring_bytes(key.c_str()), 0, 0, &properties,
                               amqp_cstring_bytes("{}")) != 0) {
            throw std::runtime_error("rabbitmq-c failed: basic.publish");
        }
    }

    // The next delivery, or false after the timeout.
    bool Next(Delivery& out, int timeoutMs) {
        amqp_maybe_release_buffers(state_);
        amqp_envelope_t envelope;
        timeval timeout{timeoutMs / 1000, (timeoutMs % 1000) * 1000};
        const amqp_rpc_reply_t reply = amqp_consume_message(state_, &envelope, &timeout, 0);
        if (reply.reply_type == AMQP_RESPONSE_LIBRARY_EXCEPTION &&
            reply.library_error == AMQP_STATUS_TIMEOUT) {
            return false;
        }
        CheckRawReply(reply, "consume");
        out.correlationId = Text(envelope.message.properties.correlation_id);
        out.replyTo = Text(envelope.message.properties.reply_to);
        amqp_destroy_envelope(&envelope);
        return true;
    }

private:
    amqp_connection_state_t state_;
};

// Runs the step until stop is set; a failure is printed and ends the loop, and
// the waiting side then runs out of time.
template <typename Step>
void RunUntil(const std::atomic<bool>& stop, Step step) {
    try {
        while (!stop) step();
    } catch (const std::exception& error) {
        std::fprintf(stderr, "service_roundtrip_bench: %s\n", error.what());
    }
}

// Answers every request on its queue to the request's reply_to key.
class RawResponder {
public:
    // With wire, the answers carry the library's properties too.
    RawResponder(const BrokerAddress& broker, const std::string& exchange, const std::string& key,
                 const amqp_basic_properties_t* wire = nullptr)
        : connection_(broker), exchange_(exchange) {
        connection_.Listen(exchange, key, key);
        thread_ = std::thread([this, wire] {
            Delivery request;
            RunUntil(stop_, [&] {
                if (connection_.Next(request, 100)) {
                    connection_.Publish(exchange_, request.replyTo, request.correlationId, "",
                                        wire);
                }
            });
        });
    }
    ~RawResponder() {
        stop_ = true;
        thread_.join();
    }

private:
    RawConnection connection_;
    const std::string exchange_;
    std::atomic<bool> stop_{false};
    std::thread thread_;
};

// Deliveries handed from one thread to another: the bus's own queue.
using HandOver = Bus::SharedQueue<Delivery>;

// A raw responder in the library's shape: it receives on one connection and
// answers on another, and its reader hands each request to a handling
// thread, which answers.
class ShapedResponder {
public:
    ShapedResponder(const BrokerAddress& broker, const std::string& exchange,
                    const std::string& key, const amqp_basic_properties_t* wire)
        : in_(broker), out_(broker), exchange_(exchange), wire_(wire) {
        in_.Listen(exchange, key, key);
        reader_ = std::thread([this] {
            Delivery request;
            RunUntil(stop_, [&] {
                if (in_.Next(request, 100)) requests_.Add(std::move(request));
            });
        });
        handler_ = std::thread([this] {
            Delivery request;
            RunUntil(stop_, [&] {
                if (requests_.TryTake(request, 100)) {
                    out_.Publish(exchange_, request.replyTo, request.correlationId, "", wire_);
                }
            });
        });
    }
    ~ShapedResponder() {
        stop_ = true;
        reader_.join();
        handler_.join();
    }

private:
    RawConnection in_, out_;
    const std::string exchange_;
    const amqp_basic_properties_t* wire_;
    HandOver requests_;
    std::atomic<bool> stop_{false};
    std::thread reader_, handler_;
};

// The raw round trip in the library's shape, with no library code in it: the
// shaped responder, and a requester that sends on one connection while a
// reader on another hands each reply to the waiting caller. Against the plain
// raw round trip it shows what that shape costs by itself.
class ShapedRoundTrip {
public:
    ShapedRoundTrip(const BrokerAddress& broker, const std::string& exchange,
                    const std::string& server, const std::string& reply,
                    const amqp_basic_properties_t* wire)
        : responder_(broker, exchange, server, wire),
          in_(broker),
          out_(broker),
          exchange_(exchange),
          server_(server),
          reply_(reply),
          wire_(wire) {
        in_.Listen(exchange, reply, reply);
        reader_ = std::thread([this] {
            Delivery reply;
            RunUntil(stop_, [&] {
                if (in_.Next(reply, 100)) replies_.Add(std::move(reply));
            });
        });
    }
    ~ShapedRoundTrip() {
        stop_ = true;
        reader_.join();
    }

    bool RoundTrip(const std::string& id) {
        out_.Publish(exchange_, server_, id, reply_, wire_);
        Delivery response;
        while (replies_.TryTake(response, kReplyTimeoutMs)) {
            if (response.correlationId == id) return true;
        }
        return false;
    }

private:
    ShapedResponder responder_;
    RawConnection in_, out_;
    const std::string exchange_, server_, reply_;
    const amqp_basic_properties_t* wire_;
    HandOver replies_;
    std::atomic<bool> stop_{false};
    std::thread reader_;
};

// ---- Through MessageService ----

class BenchRequest : public Bus::RequestMessage {
public:
    explicit BenchRequest(const std::string& target)
        : RequestMessage("BenchRequest", "application/json", target) {}
    Bus::MessageBody Serialize() const override { return Bus::MessageBody(std::string("{}")); }
};

// The properties MessageService puts on a request (type, time, identity,
// reply-to, origin, the header table), so that the raw baseline can carry the
// same bytes on the wire.
class LibraryWire {
public:
    LibraryWire() {
        BenchRequest request("bench.raw.server");
        request.Headers().SetReplyTo("bench_client");
        request.Headers().SetOrigin("bench_client");
        request.EnsureIdentity();
        record_ = Bus::ToAmqpProperties(request.Headers());
        properties_ = std::make_unique<Bus::AmqpBasicProperties>(record_);
    }
    LibraryWire(const LibraryWire&) = delete;
    LibraryWire& operator=(const LibraryWire&) = delete;
    const amqp_basic_properties_t* Get() const { return properties_->Get(); }

private:
    Bus::AmqpProperties record_;
    std::unique_ptr<Bus::AmqpBasicProperties> properties_;  // points into record_
};

// Null for the minimal message (argument 0), else the library's properties.
const amqp_basic_properties_t* WireOf(const benchmark::State& state) {
    static const LibraryWire wire;
    return state.range(0) == 0 ? nullptr : wire.Get();
}

// The figures' name of a raw run.
std::string RawName(const benchmark::State& state, const char* base) {
    return std::string(base) + (state.range(0) == 0 ? "_minimal" : "");
}

std::unique_ptr<Bus::AmqpConnectionManager> MakeManager(const BrokerAddress& broker) {
    return Korvane::Veldra::Bench::MakeManager(broker, "kvveldra.bench.service");
}

// Client and server each with a manager of their own, as two processes would.
struct ServiceWorld {
    explicit ServiceWorld(const BrokerAddress& broker)
        : serverManager(MakeManager(broker)),
          clientManager(MakeManager(broker)),
          server(ServiceSettings(*serverManager, "bench_server")),
          client(ServiceSettings(*clientManager, "bench_client")) {
        server.Subscriber()->RegisterMessageCallback(
            "BenchRequest", std::make_shared<AnsweringResponder>(server), false);
    }
    std::unique_ptr<Bus::AmqpConnectionManager> serverManager, clientManager;
    Bus::MessageService server, client;
};

// ---- Figures ----

struct Figures {
    double p50Us = 0, p99Us = 0, perSecond = 0;
};
std::map<std::string, Figures> g_figures;
std::optional<BrokerAddress> g_broker;
std::unique_ptr<ServiceWorld> g_service;
const std::string g_tag = std::to_string(getpid());

double Percentile(std::vector<double> values, double fraction) {
    std::sort(values.begin(), values.end());
    return values[static_cast<size_t>(fraction * (values.size() - 1))];
}

// Runs one round trip per iteration, timing each; roundTrip returns false
// when no response came.
template <typename RoundTrip>
void MeasureSequential(benchmark::State& state, const char* name, RoundTrip roundTrip) {
    std::vector<double> latencies;
    latencies.reserve(kSequentialRoundTrips);
    const auto start = Clock::now();
    for (auto _ : state) {
        const auto sent = Clock::now();
        if (!roundTrip()) {
            state.SkipWithError("no response in time");
            return;
        }
        latencies.push_back(std::chrono::duration<double, std::micro>(Clock::now() - sent).count());
    }
    const double seconds = std::chrono::duration<double>(Clock::now() - start).count();
    Figures& figures = g_figures[name];
    figures = {Percentile(latencies, 0.5), Percentile(latencies, 0.99), latencies.size() / seconds};
    state.counters["p50_us"] = figures.p50Us;
    state.counters["p99_us"] = figures.p99Us;
    state.counters["round_trips_per_s"] = figures.perSecond;
}

void BM_RoundTripRawShaped(benchmark::State& state) {
    const std::string exchange = "kvveldra.bench.raw", server = "bench.raw.sserver." + g_tag;
    const std::string reply = "bench.raw.sclient." + g_tag;
    ShapedRoundTrip shaped(*g_broker, exchange, server, reply, WireOf(state));
    int next = 0;
    MeasureSequential(state, "raw_shaped",
                      [&] { return shaped.RoundTrip(std::to_string(next++)); });
}

void BM_RoundTripRaw(benchmark::State& state) {
    const std::string exchange = "kvveldra.bench.raw", server = "bench.raw.server." + g_tag;
    const std::string reply = "bench.raw.client." + g_tag;
    const amqp_basic_properties_t* wire = WireOf(state);
    RawResponder responder(*g_broker, exchange, server, wire);
    RawConnection client(*g_broker);
    client.Listen(exchange, reply, reply);
    int next = 0;
    MeasureSequential(state, RawName(state, "raw").c_str(), [&] {
        const std::string id = std::to_string(next++);
        client.Publish(exchange, server, id, reply, wire);
        Delivery response;
        while (client.Next(response, kReplyTimeoutMs)) {
            if (response.correlationId == id) return true;
        }
        return false;
    });
}

void BM_RoundTripService(benchmark::State& state) {
    const std::string target = g_service->server.QueueName();
    MeasureSequential(state, "service", [&] {
        BenchRequest request(target);
        return g_service->client.SendRequest(request, kReplyTimeoutMs) != nullptr;
    });
}

// kPipelineThreads senders, each with at most kPipelineWindow requests in
// flight; a response frees a place in its sender's window. send(thread,
// index) sends one request; responses call Completed(thread).
class Pipeline {
public:
    Pipeline() : windows_(kPipelineThreads) {
        for (auto& window : windows_) {
            for (int i = 0; i < kPipelineWindow; ++i) window.Release();
        }
    }
    template <typename Send>
    double Run(Send send) {
        const auto start = Clock::now();
        std::vector<std::thread> senders;
        for (int t = 0; t < kPipelineThreads; ++t) {
            senders.emplace_back([&, t] {
                try {
                    for (int i = 0; i < kPipelinePerThread; ++i) {
                        windows_[t].Acquire(Bus::Semaphore::kInfinite);
                        send(t, i);
                    }
                } catch (const std::exception& error) {
                    // The missing responses end the run below.
                    std::fprintf(stderr, "service_roundtrip_bench: %s\n", error.what());
                }
            });
        }
        for (auto& sender : senders) sender.join();
        // Every window full again: every response is in.
        for (auto& window : windows_) {
            for (int i = 0; i < kPipelineWindow; ++i) {
                if (!window.Acquire(kReplyTimeoutMs)) return 0;
            }
        }
        const double seconds = std::chrono::duration<double>(Clock::now() - start).count();
        return kPipelineThreads * kPipelinePerThread / seconds;
    }
    void Completed(uint32_t thread) {
        if (thread < windows_.size()) windows_[thread].Release();
    }

private:
    std::vector<Bus::Semaphore> windows_;
};

void ReportPipeline(benchmark::State& state, const char* name, double perSecond) {
    if (perSecond == 0) {
        state.SkipWithError("responses missing");
        return;
    }
    g_figures[name].perSecond = perSecond;
    state.counters["requests_per_s"] = perSecond;
    state.SetItemsProcessed(static_cast<int64_t>(kPipelineThreads) * kPipelinePerThread);
}

// Argument 2 set: the responder in the library's shape (ShapedResponder).
void BM_PipelinedRaw(benchmark::State& state) {
    const std::string exchange = "kvveldra.bench.raw", server = "bench.raw.pserver." + g_tag;
    const std::string reply = "bench.raw.pclient." + g_tag;
    const amqp_basic_properties_t* wire = WireOf(state);
    const bool shaped = state.range(1) != 0;
    for (auto _ : state) {
        std::optional<RawResponder> plain;
        std::optional<ShapedResponder> handed;
        if (shaped) {
            handed.emplace(*g_broker, exchange, server, wire);
        } else {
            plain.emplace(*g_broker, exchange, server, wire);
        }
        RawConnection publisher(*g_broker), consumer(*g_broker);
        consumer.Listen(exchange, reply, reply);
        Pipeline pipeline;
        std::atomic<bool> stop{false};
        std::thread reader([&] {
            Delivery response;
            RunUntil(stop, [&] {
                if (consumer.Next(response, 100)) {
                    pipeline.Completed(std::stoul(response.correlationId));
                }
            });
        });
        std::mutex publishMutex;  // rabbitmq-c connections are not thread-safe
        const double perSecond = pipeline.Run([&](int thread, int index) {
            const std::string id = std::to_string(thread) + "-" + std::to_string(index);
            std::lock_guard<std::mutex> lock(publishMutex);
            publisher.Publish(exchange, server, id, reply, wire);
        });
        stop = true;
        reader.join();
        ReportPipeline(state,
                       shaped ? "raw_pipelined_shaped" : RawName(state, "raw_pipelined").c_str(),
                       perSecond);
    }
}

// Frees the window of the sender whose number is the state minus one.
class WindowRelease : public Bus::Interfaces::IResponseCallback {
public:
    explicit WindowRelease(Pipeline& pipeline) : pipeline_(pipeline) {}
    void OnResponse(std::shared_ptr<Bus::GenericMessage>, uint32_t state) override {
        pipeline_.Completed(state - 1);
    }

private:
    Pipeline& pipeline_;
};

void BM_PipelinedService(benchmark::State& state) {
    const std::string target = g_service->server.QueueName();
    for (auto _ : state) {
        Pipeline pipeline;
        WindowRelease release(pipeline);
        g_service->client.SetStateResponseCallback(&release);
        const double perSecond = pipeline.Run([&](int thread, int) {
            BenchRequest request(target);
            g_service->client.SendRequestAsync(request, static_cast<uint32_t>(thread) + 1);
        });
        g_service->client.SetStateResponseCallback(nullptr);
        ReportPipeline(state, "service_pipelined", perSecond);
    }
}

// Raw runs: argument 0 sends a minimal message (content type, correlation id,
// reply-to, "{}"), 1 the same properties and header table as MessageService.
BENCHMARK(BM_RoundTripRaw)->Arg(0)->Arg(1)->Iterations(kSequentialRoundTrips)->UseRealTime();
BENCHMARK(BM_RoundTripRawShaped)->Arg(1)->Iterations(kSequentialRoundTrips)->UseRealTime();
BENCHMARK(BM_RoundTripService)->Iterations(kSequentialRoundTrips)->UseRealTime();
BENCHMARK(BM_PipelinedRaw)->Args({0, 0})->Args({1, 0})->Args({1, 1})->Iterations(1)->UseRealTime();
BENCHMARK(BM_PipelinedService)->Iterations(1)->UseRealTime();

void PrintRatios() {
    using Korvane::Veldra::Bench::PrintRatio;
    const Figures raw = g_figures["raw"], service = g_figures["service"];
    PrintRatio("round trip p50, MessageService / raw", service.p50Us, raw.p50Us, "<= 1.08");
    PrintRatio("round trip p99, MessageService / raw", service.p99Us, raw.p99Us, "-");
    // The threads and connections the design prescribes, without the library.
    const Figures shaped = g_figures["raw_shaped"];
    PrintRatio("round trip p50, raw in the library's shape / raw", shaped.p50Us, raw.p50Us, "-");
    PrintRatio("round trip p50, MessageService / raw in the library's shape", service.p50Us,
               shaped.p50Us, "-");
    PrintRatio("sequential round trips/s, MessageService / raw", service.perSecond, raw.perSecond,
               "-");
    PrintRatio("pipelined requests/s, SendRequestAsync / raw",
               g_figures["service_pipelined"].perSecond, g_figures["raw_pipelined"].perSecond,
               ">= 0.95");
    PrintRatio("pipelined requests/s, raw with the library's responder shape / raw",
               g_figures["raw_pipelined_shaped"].perSecond, g_figures["raw_pipelined"].perSecond,
               "-");
    // The same against a raw message without the library's header table.
    const Figures minimal = g_figures["raw_minimal"];
    PrintRatio("round trip p50, MessageService / raw minimal message", service.p50Us, minimal.p50Us,
               "-");
    PrintRatio("pipelined requests/s, SendRequestAsync / raw minimal message",
               g_figures["service_pipelined"].perSecond,
               g_figures["raw_pipelined_minimal"].perSecond, ">= 0.95");
    // What the library's properties cost rabbitmq-c and the broker alone.
    PrintRatio("pipelined requests/s, raw with the library's properties / raw minimal message",
               g_figures["raw_pipelined"].perSecond, g_figures["raw_pipelined_minimal"].perSecond,
               "-");
}

}  // namespace

int main(int argc, char** argv) {
    g_broker = BrokerOrSkip("service_roundtrip_bench");
    if (!g_broker) return 0;
    benchmark::Initialize(&argc, argv);
    if (benchmark::ReportUnrecognizedArguments(argc, argv)) return 1;
    try {
        g_service = std::make_unique<ServiceWorld>(*g_broker);
    } catch (const std::exception& error) {
        std::fprintf(stderr, "service_roundtrip_bench: no services on %s:%d: %s\n",
                     g_broker->host.c_str(), g_broker->port, error.what());
        return 1;
    }
    benchmark::RunSpecifiedBenchmarks();
    g_service.reset();
    PrintRatios();
    benchmark::Shutdown();
    return 0;
}
