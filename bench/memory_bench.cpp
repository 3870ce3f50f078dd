// Resident size of a process with one requesting MessageService (and the
// responder it talks to) after a tenth of the requests and after all of them:
// flat means no per-request state is left behind (correlation entries,
// buffers, trace points).
//
//   tests/integration/broker/broker.sh start /tmp/broker.env
//   KVVELDRA_BROKER_ENV=/tmp/broker.env build/bench/memory_bench
//
// KVVELDRA_MEMORY_REQUESTS sets the count (default 1000000). Without a broker
// the benchmark says so and does nothing.
#include <unistd.h>

#include <atomic>
#include <cstdio>
#include <cstdlib>
#include <memory>
#include <string>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/service/MessageService.h"
#include "messagelibrary/RequestMessage.h"
#include "support/BenchBroker.h"
#include "support/BenchServices.h"
#include "support/Ratios.h"
#include "support/ResidentSize.h"

namespace {

namespace Bus = Korvane::Veldra::MessageBus;
namespace Bench = Korvane::Veldra::Bench;
using Bench::ResidentKiB;

constexpr int kWindow = 64;  // requests in flight
constexpr uint32_t kReplyTimeoutMs = 10000;

class MemoryRequest : public Bus::RequestMessage {
public:
    explicit MemoryRequest(const std::string& target)
        : RequestMessage("MemoryRequest", "application/json", target) {}
    Bus::MessageBody Serialize() const override {
        return Bus::MessageBody(std::string(R"({"paths":["Plant1.Area2.Line3.Sensor00042"]})"));
    }
};

class WindowRelease : public Bus::Interfaces::IResponseCallback {
public:
    explicit WindowRelease(Bus::Semaphore& window) : window_(window) {}
    void OnResponse(std::shared_ptr<Bus::GenericMessage>, uint32_t) override {
        ++answered;
        window_.Release();
    }
    std::atomic<long> answered{0};

private:
    Bus::Semaphore& window_;
};

}  // namespace

int main() {
    const auto broker = Bench::BrokerOrSkip("memory_bench");
    if (!broker) return 0;
    const char* configured = std::getenv("KVVELDRA_MEMORY_REQUESTS");
    const long total = configured != nullptr ? std::atol(configured) : 1000000;
    if (total < 10) {
        std::fprintf(stderr, "memory_bench: KVVELDRA_MEMORY_REQUESTS must be at least 10\n");
        return 1;
    }
    auto serverManager = Bench::MakeManager(*broker, "kvveldra.bench.memory");
    auto clientManager = Bench::MakeManager(*broker, "kvveldra.bench.memory");
    Bus::MessageService server(Bench::ServiceSettings(*serverManager, "memory_server"));
    Bus::MessageService client(Bench::ServiceSettings(*clientManager, "memory_client"));
    server.Subscriber()->RegisterMessageCallback(
        "MemoryRequest", std::make_shared<Bench::AnsweringResponder>(server), false);
    Bus::Semaphore window;
    for (int i = 0; i < kWindow; ++i) window.Release();
    WindowRelease release(window);
    client.SetStateResponseCallback(&release);

    long checkpoint = 0;
    for (long sent = 0; sent < total; ++sent) {
        if (!window.Acquire(kReplyTimeoutMs)) {
            std::fprintf(stderr, "memory_bench: no response within %u ms after %ld requests\n",
                         kReplyTimeoutMs, sent);
            return 1;
        }
        if (sent == total / 10) {
            checkpoint = ResidentKiB();
            std::printf("resident after %ld requests: %ld KiB\n", sent, checkpoint);
        }
        MemoryRequest request(server.QueueName());
        client.SendRequestAsync(request, 1);
    }
    for (int i = 0; i < kWindow; ++i) window.Acquire(kReplyTimeoutMs);
    client.SetStateResponseCallback(nullptr);
    const long end = ResidentKiB();
    std::printf("resident after %ld requests: %ld KiB (%ld answered)\n", total, end,
                release.answered.load());
    Bench::PrintRatio("resident size, " + std::to_string(total) + " / " +
                          std::to_string(total / 10) + " requests",
                      static_cast<double>(end), static_cast<double>(checkpoint), "<= 1.02");
    return 0;
}
