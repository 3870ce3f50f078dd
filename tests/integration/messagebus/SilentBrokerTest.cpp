#include <gtest/gtest.h>
#include <signal.h>

#include <chrono>
#include <fstream>
#include <future>
#include <memory>
#include <optional>
#include <string>
#include <thread>
#include <type_traits>

#include "errors/AmqpException.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpPublisherConnection.h"
#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Testing {
namespace {

using namespace std::chrono_literals;

// Freezes the broker's node with SIGSTOP, so that its sockets stay open and
// its kernel still acknowledges, but nothing is read or answered; thaws it
// again at the end of the scope.
class FrozenBroker {
public:
    FrozenBroker() {
        std::ifstream file(Broker().Directory + "/node.pid");
        file >> pid_;
        if (pid_ > 0 && kill(pid_, SIGSTOP) != 0) pid_ = 0;
    }
    ~FrozenBroker() {
        if (pid_ > 0) kill(pid_, SIGCONT);
    }
    bool Frozen() const { return pid_ > 0; }

private:
    pid_t pid_ = 0;
};

// Runs body on a thread of its own and waits for it within bound. A body
// still running then is detached, so that the hang fails the test instead of
// stalling the suite: it must own, through what it captured, all it uses.
template <typename Body>
std::optional<std::invoke_result_t<Body>> RunBounded(Body body, std::chrono::seconds bound) {
    std::packaged_task<std::invoke_result_t<Body>()> task(std::move(body));
    auto result = task.get_future();
    std::thread thread(std::move(task));
    if (result.wait_for(bound) != std::future_status::ready) {
        thread.detach();
        return std::nullopt;
    }
    thread.join();
    return result.get();
}

// A publisher connection to the private broker with a short heartbeat, and
// so a short stall limit, and its first channel.
std::shared_ptr<MessageBus::AmqpPublisherConnection> MakePublisher(int32_t heartbeatSeconds) {
    auto publisher = std::make_shared<MessageBus::AmqpPublisherConnection>(
        nullptr, Broker().User, Broker().Password, Broker().Host, Broker().AmqpPort,
        "kvveldra.amqpio.test", false, "", "", 10000, heartbeatSeconds);
    publisher->CreateChannel();
    return publisher;
}

TEST(SilentBroker, PublishIntoAFrozenBrokerFailsInsteadOfHanging) {
    // A heartbeat of five seconds gives a stall limit of five seconds.
    const auto publisher = MakePublisher(5);
    MessageBus::MessageHeaders headers;
    headers.messageType = "Filler";
    headers.routingKey = "Veldra.nobody.Filler";
    const auto body = std::make_shared<MessageBus::MessageBody>(std::string(1 << 20, 'x'));

    FrozenBroker frozen;
    ASSERT_TRUE(frozen.Frozen()) << "cannot stop the broker's node";
    // Once the socket buffers are full a publish waits for the broker, which
    // never reads: the watchdog must end that wait.
    const auto code = RunBounded(
        [publisher, headers, body]() -> int32_t {
            for (;;) {
                try {
                    publisher->Publish(1, headers, *body, false);
                } catch (const MessageBus::AmqpException& error) {
                    return error.Code();
                }
            }
        },
        60s);
    ASSERT_TRUE(code) << "a publish is still held by the frozen broker";
    EXPECT_EQ(*code, ErrorCodes::kPublishingMessage);
}

TEST(SilentBroker, ChannelOpenOnAFrozenBrokerGivesUpWithinHalfAHeartbeat) {
    // Heartbeats alone would end the wait only after 12 to 24 seconds of
    // silence; the method call gives up after half a heartbeat interval.
    const auto publisher = MakePublisher(12);
    FrozenBroker frozen;
    ASSERT_TRUE(frozen.Frozen()) << "cannot stop the broker's node";
    const auto waited = RunBounded(
        [publisher] {
            const auto start = std::chrono::steady_clock::now();
            EXPECT_THROW(publisher->CreateChannel(), MessageBus::AmqpException);
            return std::chrono::duration_cast<std::chrono::milliseconds>(
                       std::chrono::steady_clock::now() - start)
                .count();
        },
        60s);
    ASSERT_TRUE(waited) << "a channel open is still held by the frozen broker";
    EXPECT_LT(*waited, 9000);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
