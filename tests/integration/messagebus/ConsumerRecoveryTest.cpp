#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <atomic>
#include <stdexcept>
#include <string>
#include <vector>

#include "BusTestSupport.h"
#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpConsumerConnection.h"
#include "messagebus/amqp/AmqpFrames.h"
#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Testing {
namespace {

using ::testing::Contains;
using ::testing::HasSubstr;

constexpr int32_t kConnectTimeoutMs = 10000;
// Far below the stall watchdog's limit (the heartbeat, 270 seconds): a
// consumer that waits for the watchdog misses it.
constexpr milliseconds kPromptly(10000);

// Status lines of the manager until one contains the text or the time is up;
// every line taken is kept in seen.
bool AwaitStatusLine(MessageBus::AmqpConnectionManager& manager, const std::string& text,
                     std::vector<std::string>& seen) {
    const auto deadline = std::chrono::steady_clock::now() + kPromptly;
    std::string line;
    while (std::chrono::steady_clock::now() < deadline) {
        if (!manager.TakeLog(line, 100)) continue;
        seen.push_back(line);
        if (line.find(text) != std::string::npos) return true;
    }
    return false;
}

TEST(ConsumerRecovery, ChannelClosedByTheBrokerIsReopenedOnTheSameConnection) {
    auto manager = MakeTestManager(kConnectTimeoutMs);
    const std::string queue = UniqueQueueName("amqpio_channel_close");
    TestConsumer consumer(*manager, queue);
    const auto channel = manager->CreatePublisherChannel();
    ASSERT_TRUE(ProbeArrives(*manager, channel, consumer, queue, kPromptly));
    std::vector<std::string> connectionsBefore;
    ASSERT_TRUE(ListConnections(connectionsBefore));

    // A delivery tag the channel never gave out: the broker closes the channel.
    consumer.consumer->Ack(987654321);
    std::vector<std::string> lines;
    ASSERT_TRUE(AwaitStatusLine(*manager, "AMQP channel was unexpectedly closed.", lines));

    EXPECT_TRUE(ProbeArrives(*manager, channel, consumer, queue, kPromptly));
    std::vector<std::string> connectionsAfter;
    ASSERT_TRUE(ListConnections(connectionsAfter));
    EXPECT_EQ(connectionsAfter, connectionsBefore);
    for (std::string line; manager->TakeLog(line, 0);) lines.push_back(line);
    EXPECT_THAT(lines, ::testing::Not(Contains("Attempting to reconnect to AMQP...")));
    MessageBus::VeldraException error(0, "");
    EXPECT_FALSE(manager->GetLastError(error)) << error.what();
}

TEST(ConsumerRecovery, ChannelClosedByAFailedDeclarationIsReopenedByTheNext) {
    // A short heartbeat gives a short stall limit (five seconds).
    MessageBus::AmqpConsumerConnection connection(
        nullptr, Broker().User, Broker().Password, Broker().Host, Broker().AmqpPort,
        "kvveldra.amqpio.test", false, "", "", kConnectTimeoutMs, 5);
    connection.Start();  // the reconnect thread keeps the watchdog
    const auto channel = connection.CreateChannel();
    const std::string queue = UniqueQueueName("amqpio_failed_declare");
    connection.DeclareQueue(channel->Id, queue, false, false, true);

    // The same name declared durable: the broker refuses and closes the channel.
    EXPECT_THROW(connection.DeclareQueue(channel->Id, queue, true, false, true),
                 MessageBus::AmqpException);
    const auto start = std::chrono::steady_clock::now();
    EXPECT_NO_THROW(connection.DeclareQueue(channel->Id, queue, false, false, true));
    const auto took = std::chrono::steady_clock::now() - start;
    EXPECT_LT(std::chrono::duration_cast<milliseconds>(took).count(), 2000);
}

// A consumer connection whose next reader step throws on request.
class FailingReaderConnection : public MessageBus::AmqpConsumerConnection {
public:
    using AmqpConsumerConnection::AmqpConsumerConnection;
    // The reader calls ReaderStep until Stop: it must end before this object.
    ~FailingReaderConnection() override { Stop(); }

    std::atomic<bool> failNext{false};

protected:
    void ReaderStep() override {
        if (failNext.exchange(false)) throw std::runtime_error("reader failed on purpose");
        AmqpConsumerConnection::ReaderStep();
    }
};

TEST(ConsumerRecovery, ReaderThatThrowsReconnectsAndReportsTheError) {
    auto manager = MakeTestManager(kConnectTimeoutMs);
    FailingReaderConnection connection(manager.get(), Broker().User, Broker().Password,
                                       Broker().Host, Broker().AmqpPort, "kvveldra.amqpio.test",
                                       false, "", "", kConnectTimeoutMs, 30);
    const std::string queue = UniqueQueueName("amqpio_reader_throws");
    const auto consumed = connection.CreateChannel();
    const auto subscribe = [&] {
        connection.DeclareQueue(consumed->Id, queue, false, false, true);
        connection.BindAndConsume(consumed->Id, queue, {queue, "#"}, true);
    };
    subscribe();
    connection.Start();

    connection.failNext = true;
    // The reset that follows a reconnect asks the consumer to subscribe again.
    ASSERT_TRUE(consumed->ChannelReset.Acquire(static_cast<uint32_t>(kPromptly.count())));
    MessageBus::VeldraException error(0, "");
    ASSERT_TRUE(manager->GetLastError(error));
    EXPECT_THAT(error.what(), HasSubstr("reader failed on purpose"));

    subscribe();
    manager->Publish(manager->CreatePublisherChannel(), HeadersTo(queue, "Probe", "after"),
                     MessageBus::MessageBody(), false);
    MessageBus::EnvelopePtr envelope;
    ASSERT_TRUE(consumed->Envelopes->TryTake(envelope, static_cast<uint32_t>(kPromptly.count())));
    EXPECT_EQ(MessageBus::BytesText(envelope->message.properties.correlation_id), "after");
}

// A trace logger that fails on every error entry.
class ThrowingTraceLogger : public MessageBus::Interfaces::ITraceLogger {
public:
    MessageBus::TracePoint GetTracePoint(const std::string& name) override {
        return MessageBus::TracePoint(name);
    }
    void Log(const MessageBus::TracePoint&, const std::string&) override {}
    void Error(const std::string&) override { throw std::runtime_error("logger failed"); }
};

TEST(ConsumerRecovery, HandlingThreadOutlivesAFailingErrorReport) {
    auto manager = MakeTestManager(kConnectTimeoutMs);
    const std::string queue = UniqueQueueName("amqpio_report_throws");
    TestConsumer consumer(*manager, queue);
    consumer.consumer->SetTraceLogger(std::make_shared<ThrowingTraceLogger>());
    const auto channel = manager->CreatePublisherChannel();

    // The handler fails, and so does the report of its failure.
    consumer.callback->ThrowFor("fails");
    manager->Publish(channel, HeadersTo(queue, "Probe", "fails"), MessageBus::MessageBody(), false);
    ASSERT_NE(consumer.callback->WaitForMessage("fails", kPromptly), nullptr);
    std::vector<std::string> lines;
    EXPECT_TRUE(AwaitStatusLine(*manager, "handler failed on purpose", lines));

    EXPECT_TRUE(ProbeArrives(*manager, channel, consumer, queue, kPromptly));
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
