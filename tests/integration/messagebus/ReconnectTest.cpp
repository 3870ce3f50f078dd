#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <future>
#include <string>
#include <thread>
#include <vector>

#include "BusTestSupport.h"
#include "messagebus/amqp/AmqpConsumerConnection.h"
#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Testing {
namespace {

using ::testing::Contains;

constexpr int32_t kConnectTimeoutMs = 60000;

class Reconnect : public ::testing::Test {
protected:
    void SetUp() override { ASSERT_TRUE(Probe()) << "before the outage"; }

    ::testing::AssertionResult Probe() {
        return ProbeArrives(*manager, channel, *consumer, queue, milliseconds(kConnectTimeoutMs));
    }
    std::vector<std::string> StatusLines() {
        std::vector<std::string> lines;
        for (std::string line; manager->TakeLog(line, 0);) lines.push_back(line);
        return lines;
    }

    std::unique_ptr<MessageBus::AmqpConnectionManager> manager = MakeTestManager(kConnectTimeoutMs);
    std::string queue = UniqueQueueName("amqpio_reconnect");
    std::unique_ptr<TestConsumer> consumer = std::make_unique<TestConsumer>(*manager, queue);
    std::shared_ptr<MessageBus::AmqpChannel> channel = manager->CreatePublisherChannel();
};

TEST_F(Reconnect, ConsumerComesBackAfterTheBrokerClosesAllConnections) {
    StatusLines();
    ASSERT_TRUE(CloseAllConnections());

    // The auto-deleted queue is declared and bound again on the new
    // connection, so a new message arrives.
    EXPECT_TRUE(Probe());
    const auto lines = StatusLines();
    EXPECT_THAT(lines, Contains("AMQP connection was unexpectedly closed."));
    EXPECT_THAT(lines, Contains("Attempting to reconnect to AMQP..."));
    EXPECT_THAT(lines, Contains("Publisher connection attempting to reconnect to AMQP..."));
    MessageBus::VeldraException error(0, "");
    EXPECT_FALSE(manager->GetLastError(error)) << error.what();
}

TEST_F(Reconnect, ConsumerComesBackAfterTheBrokerApplicationRestarts) {
    const ::testing::AssertionResult stopped = StopApp();
    const ::testing::AssertionResult started = StartApp();
    ASSERT_TRUE(stopped);
    ASSERT_TRUE(started);

    EXPECT_TRUE(Probe());
    MessageBus::VeldraException error(0, "");
    EXPECT_FALSE(manager->GetLastError(error)) << error.what();
}

TEST(BusThreads, NoThreadOutlivesTheManager) {
    // A first thread lets a sanitizer start its own helper thread now.
    std::thread([] {}).join();
    const int before = AwaitThreadCount(-1, milliseconds(0));
    auto manager = MakeTestManager(kConnectTimeoutMs);
    auto channel = manager->CreatePublisherChannel();
    auto first = std::make_unique<TestConsumer>(*manager, UniqueQueueName("amqpio_threads"));
    auto second = std::make_unique<TestConsumer>(*manager, UniqueQueueName("amqpio_threads"));
    // Publisher reader and reconnect, consumer reader and reconnect, and the
    // handling and rebind threads of each consumer.
    const int running = before + 8;
    EXPECT_EQ(AwaitThreadCount(running, milliseconds(5000)), running);

    // One consumer still wants messages: the connection's threads go on.
    second->Stop();
    EXPECT_EQ(manager->GetConsumerConnection()->GetStartCount(), 1);
    EXPECT_EQ(AwaitThreadCount(running, milliseconds(0)), running);
    first->Stop();
    EXPECT_EQ(AwaitThreadCount(running - 2, milliseconds(5000)), running - 2);

    // Bounded only so that a hang fails the test instead of stalling it.
    auto destroyed = std::async(std::launch::async, [&] {
        first.reset();
        second.reset();
        manager.reset();
    });
    ASSERT_EQ(destroyed.wait_for(std::chrono::seconds(30)), std::future_status::ready);
    EXPECT_EQ(AwaitThreadCount(before, milliseconds(5000)), before);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
