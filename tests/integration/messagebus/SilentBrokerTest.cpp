#include <gtest/gtest.h>
#include <signal.h>

#include <chrono>
#include <fstream>
#include <future>
#include <string>

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

TEST(SilentBroker, PublishIntoAFrozenBrokerFailsInsteadOfHanging) {
    // A short heartbeat gives a short stall limit (five seconds).
    MessageBus::AmqpPublisherConnection publisher(nullptr, Broker().User, Broker().Password,
                                                  Broker().Host, Broker().AmqpPort,
                                                  "kvveldra.amqpio.test", false, "", "", 10000, 5);
    const auto channel = publisher.CreateChannel();
    MessageBus::MessageHeaders headers;
    headers.messageType = "Filler";
    headers.routingKey = "Veldra.nobody.Filler";
    const MessageBus::MessageBody body(std::string(1 << 20, 'x'));

    FrozenBroker frozen;
    ASSERT_TRUE(frozen.Frozen()) << "cannot stop the broker's node";
    // Once the socket buffers are full a publish waits for the broker, which
    // never reads: the watchdog must end that wait.
    auto publishing = std::async(std::launch::async, [&]() -> int32_t {
        for (;;) {
            try {
                publisher.Publish(channel->Id, headers, body, false);
            } catch (const MessageBus::AmqpException& error) {
                return error.Code();
            }
        }
    });
    ASSERT_EQ(publishing.wait_for(60s), std::future_status::ready)
        << "a publish is still held by the frozen broker";
    EXPECT_EQ(publishing.get(), ErrorCodes::kPublishingMessage);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
