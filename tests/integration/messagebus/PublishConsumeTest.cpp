#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <utility>
#include <vector>

#include "BusTestSupport.h"
#include "messagebus/amqp/AmqpFrames.h"
#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {
namespace {

using MessageBus::MessageBody;
using MessageBus::MessageHeaders;

constexpr milliseconds kArrival(20000);

class PublishConsume : public ::testing::Test {
protected:
    std::unique_ptr<MessageBus::AmqpConnectionManager> manager = MakeTestManager(30000);
    std::string queue = UniqueQueueName("amqpio_pubsub");
    std::unique_ptr<TestConsumer> consumer = std::make_unique<TestConsumer>(*manager, queue);
    std::shared_ptr<MessageBus::AmqpChannel> channel = manager->CreatePublisherChannel();
};

TEST_F(PublishConsume, MessageArrivesWithItsHeadersAndProperties) {
    MessageHeaders sent = HeadersTo(queue, "TagInfoQueryTagsRequest", "corr-headers");
    sent.SetHeader("ReplyTo", "someone_else");
    sent.SetHeader("Zeta", "last");
    sent.SetHeader("Alpha", "first");
    manager->Publish(channel, sent, MessageBody(std::string("{\"a\":1}")), false);

    const auto received = consumer->callback->WaitForMessage("corr-headers", kArrival);
    ASSERT_NE(received, nullptr);
    EXPECT_EQ(received->MessageType(), "TagInfoQueryTagsRequest");
    EXPECT_EQ(received->ContentType(), "application/json");
    EXPECT_EQ(received->RoutingKey(), sent.routingKey);
    EXPECT_EQ(received->Body().ToString(), "{\"a\":1}");
    for (const char* key : {"ReplyTo", "Zeta", "Alpha"}) {
        EXPECT_EQ(received->Headers().HeaderOrEmpty(key), sent.HeaderOrEmpty(key)) << key;
    }
    // No "Persistent" key was sent, so no delivery mode: the receiver says so.
    EXPECT_EQ(received->Headers().HeaderOrEmpty("Persistent"), "false");
    ASSERT_NE(received->GetHeader("ConsumerTag"), nullptr);
    EXPECT_EQ(*received->GetHeader("ConsumerTag"), "");
    EXPECT_NE(received->DeliveryTag(), 0u);
}

TEST_F(PublishConsume, WireCarriesSortedStringHeadersAndDeliveryModeFromThePersistentKey) {
    const std::string rawQueue = UniqueQueueName("amqpio_raw");
    Inbox<MessageBus::EnvelopePtr> envelopes;
    MessageBus::AmqpConsumerBuilder builder;
    builder.QueueName = rawQueue;
    builder.ConnectionManager = manager.get();
    builder.RawCallback = [&](const MessageBus::EnvelopePtr& e) { envelopes.Add(e); };
    MessageBus::AmqpConsumer raw(builder);
    raw.Bind({rawQueue, "#"});
    raw.StartConsuming();

    MessageHeaders persistent = HeadersTo(rawQueue, "SomeRoutedMessage", "corr-persistent");
    persistent.SetHeader("b", "2");
    persistent.SetHeader("a", "1");
    persistent.SetPersistent(false);  // the key counts, not its value
    manager->Publish(channel, persistent, MessageBody(), false);
    manager->Publish(channel, HeadersTo(rawQueue, "SomeRoutedMessage", "corr-bare"), MessageBody(),
                     false);

    const auto properties = [&](const std::string& correlationId) {
        const auto envelope = envelopes.WaitFor(
            [&](const auto& e) {
                return MessageBus::BytesText(e->message.properties.correlation_id) == correlationId;
            },
            kArrival);
        return envelope ? (*envelope)->message.properties : amqp_basic_properties_t{};
    };
    const amqp_basic_properties_t sent = properties("corr-persistent");
    ASSERT_TRUE(sent._flags & AMQP_BASIC_DELIVERY_MODE_FLAG);
    EXPECT_EQ(sent.delivery_mode, 2);
    std::vector<std::pair<std::string, char>> headers;
    for (int i = 0; i < sent.headers.num_entries; ++i) {
        const amqp_table_entry_t& entry = sent.headers.entries[i];
        headers.emplace_back(MessageBus::BytesText(entry.key), entry.value.kind);
    }
    EXPECT_THAT(headers,
                ::testing::ElementsAre(std::make_pair("Persistent", 'S'), std::make_pair("a", 'S'),
                                       std::make_pair("b", 'S')));

    const amqp_basic_properties_t bare = properties("corr-bare");
    ASSERT_TRUE(bare._flags & AMQP_BASIC_HEADERS_FLAG);  // with an empty table
    EXPECT_EQ(bare.headers.num_entries, 0);
    EXPECT_FALSE(bare._flags & AMQP_BASIC_DELIVERY_MODE_FLAG);
    raw.StopConsuming();
}

TEST_F(PublishConsume, MandatoryPublishWithoutQueueComesBackAsNotice) {
    manager->Publish(channel, HeadersTo("nobody_listens", "TagInfoQueryTagsRequest", "0f6e"),
                     MessageBody(std::string("{}")), true);

    const auto event =
        consumer->callback->returns.WaitFor([](const auto&) { return true; }, kArrival);
    ASSERT_TRUE(event.has_value());
    EXPECT_EQ(event->CorrelationId, "0f6e");
    EXPECT_EQ(event->Message,
              "Publish failed:  The message with mandatory routing could not be delivered. "
              "Message type: TagInfoQueryTagsRequest, correlation id: 0f6e");
}

TEST_F(PublishConsume, FailingHandlerKeepsTheConsumerGoing) {
    // The queue loses its binding behind the consumer's back, and the failing
    // message comes straight to the queue: a probe through the exchange can
    // arrive only once the consumer has bound the queue again.
    RawAmqpConnection raw;
    ASSERT_EQ(raw.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    ASSERT_TRUE(raw.Login(Broker().User, Broker().Password));
    ASSERT_TRUE(raw.OpenChannel(1));
    amqp_queue_unbind(raw.Get(), 1, amqp_cstring_bytes(queue.c_str()),
                      amqp_cstring_bytes(manager->GetExchangeName().c_str()),
                      amqp_cstring_bytes(("Veldra." + queue + ".#").c_str()), amqp_empty_table);
    ASSERT_TRUE(IsNormal(amqp_get_rpc_reply(raw.Get())));
    consumer->callback->ThrowFor("corr-boom");
    amqp_basic_properties_t properties{};
    properties._flags = AMQP_BASIC_TYPE_FLAG | AMQP_BASIC_CORRELATION_ID_FLAG;
    properties.type = amqp_cstring_bytes("SomeRoutedMessage");
    properties.correlation_id = amqp_cstring_bytes("corr-boom");
    ASSERT_EQ(amqp_basic_publish(raw.Get(), 1, amqp_empty_bytes,
                                 amqp_cstring_bytes(queue.c_str()), 0, 0, &properties,
                                 amqp_cstring_bytes("{}")),
              AMQP_STATUS_OK);
    ASSERT_NE(consumer->callback->WaitForMessage("corr-boom", kArrival), nullptr);

    // The thread lives on, and the queue is declared and bound again.
    EXPECT_TRUE(ProbeArrives(*manager, channel, *consumer, queue, kArrival));
    std::vector<std::string> lines;
    for (std::string line; manager->TakeLog(line, 0);) lines.push_back(line);
    EXPECT_THAT(lines, ::testing::Contains("Caught exception in message handling thread: "
                                           "handler failed on purpose"));
    MessageBus::VeldraException error(0, "");
    EXPECT_FALSE(manager->GetLastError(error)) << error.what();
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
