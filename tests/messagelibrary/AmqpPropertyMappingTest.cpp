#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "messagelibrary/AmqpPropertyMapping.h"
#include "messagelibrary/HeaderKeys.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using namespace AmqpPropertyFlags;
using VeldraMessageLibrary::TimestampFromUnixSeconds;

MessageHeaders SampleHeaders() {
    MessageHeaders headers;
    headers.messageType = "TagInfoQueryTagsRequest";
    headers.contentType = "application/json";
    headers.correlationId = "corr-1";
    headers.routingKey = "Veldra.TagInfo.TagInfoQueryTagsRequest";
    headers.timestamp = TimestampFromUnixSeconds(981173106);
    headers.SetHeader("b", "2");
    headers.SetHeader("a", "1");
    headers.SetHeader("B", "3");
    return headers;
}

TEST(AmqpPropertyMapping, PublishSetsExactlyTheFivePropertiesInKeyOrder) {
    const AmqpProperties properties = ToAmqpProperties(SampleHeaders(), 1700000000);
    EXPECT_EQ(properties.flags, kContentType | kTimestamp | kType | kCorrelationId | kHeaders);
    EXPECT_EQ(properties.contentType, "application/json");
    EXPECT_EQ(properties.type, "TagInfoQueryTagsRequest");
    EXPECT_EQ(properties.correlationId, "corr-1");
    EXPECT_EQ(properties.timestamp, 1700000000u);
    EXPECT_EQ(properties.deliveryMode, 0);
    std::vector<std::string> keys;
    for (const auto& entry : properties.headers) {
        keys.push_back(entry.key);
        EXPECT_EQ(entry.kind, 'S');
    }
    EXPECT_EQ(keys, (std::vector<std::string>{"B", "a", "b"}));
    EXPECT_EQ(properties.headers[1].value, "1");
}

TEST(AmqpPropertyMapping, AnyPersistentHeaderMakesTheMessagePersistent) {
    const AmqpProperties plain = ToAmqpProperties(MessageHeaders(), 0);
    EXPECT_TRUE(plain.headers.empty());
    EXPECT_NE(plain.flags & kHeaders, 0u);
    EXPECT_EQ(plain.flags & kDeliveryMode, 0u);
    for (const char* value : {"1", "0", "false", "true", ""}) {
        MessageHeaders headers;
        headers.SetHeader(HeaderKeys::kPersistent, value);
        const AmqpProperties properties = ToAmqpProperties(headers, 0);
        EXPECT_NE(properties.flags & kDeliveryMode, 0u) << value;
        EXPECT_EQ(properties.deliveryMode, 2) << value;
    }
}

AmqpProperties Received(uint8_t deliveryMode) {
    AmqpProperties properties;
    properties.flags = kContentType | kTimestamp | kType | kCorrelationId | kHeaders;
    properties.contentType = "application/json";
    properties.type = "GenericResponse";
    properties.correlationId = "abc";
    properties.timestamp = 1700000000;  // seconds on the wire, read as milliseconds
    if (deliveryMode != 0) {
        properties.flags |= kDeliveryMode;
        properties.deliveryMode = deliveryMode;
    }
    return properties;
}

TEST(AmqpPropertyMapping, ReceiveReadsPropertiesAndAddsTheLocalHeaders) {
    const MessageHeaders headers =
        HeadersFromAmqp(Received(0), "Veldra.q.GenericResponse", "ctag", 0x1FFFFFFFFULL);
    EXPECT_EQ(headers.messageType, "GenericResponse");
    EXPECT_EQ(headers.contentType, "application/json");
    EXPECT_EQ(headers.routingKey, "Veldra.q.GenericResponse");
    EXPECT_EQ(headers.correlationId, "abc");
    EXPECT_EQ(headers.timestamp, TimestampFromUnixSeconds(1700000));
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kPersistent), "false");
    EXPECT_EQ(headers.ConsumerTag(), "ctag");
    EXPECT_EQ(headers.DeliveryTag(), 0xFFFFFFFFu);
    EXPECT_EQ(headers.headers.size(), 3u);
}

TEST(AmqpPropertyMapping, ReceivedPersistenceFollowsDeliveryMode) {
    EXPECT_TRUE(HeadersFromAmqp(Received(2), "", "", 1).Persistent());
    EXPECT_FALSE(HeadersFromAmqp(Received(1), "", "", 1).Persistent());
    AmqpProperties noFlags;
    noFlags.deliveryMode = 2;
    const MessageHeaders headers = HeadersFromAmqp(noFlags, "", "", 1);
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kPersistent), "false");
}

TEST(AmqpPropertyMapping, ReceivedCorrelationIdEndsAtItsFirstZeroByte) {
    AmqpProperties properties = Received(0);
    properties.correlationId = std::string("abc\0def", 7);
    EXPECT_EQ(HeadersFromAmqp(properties, "", "", 1).correlationId, "abc");
}

TEST(AmqpPropertyMapping, ReceivedTableEntriesNeverReplaceTheLocalHeaders) {
    AmqpProperties properties = Received(2);
    // As a message re-published with the headers it was received with.
    properties.headers = {{"Persistent", 'S', "0"},
                          {"ConsumerTag", 'S', "foreign-ctag"},
                          {"DeliveryTag", 'S', "999"},
                          {"Origin", 'S', std::string("a\0b", 3)},
                          {"Count", 'I', "raw"}};
    const MessageHeaders headers = HeadersFromAmqp(properties, "", "ctag", 5);
    EXPECT_EQ(*headers.GetHeader(HeaderKeys::kPersistent), "true");
    EXPECT_EQ(headers.ConsumerTag(), "ctag");
    EXPECT_EQ(headers.DeliveryTag(), 5u);
    EXPECT_EQ(headers.Origin(), std::string("a\0b", 3));
    EXPECT_EQ(*headers.GetHeader("Count"), "raw");
}

TEST(AmqpPropertyMapping, ReceivedTableInAnyOrderKeepsTheLastValueOfARepeatedKey) {
    AmqpProperties properties = Received(0);
    properties.headers = {{"m", 'S', "1"}, {"z", 'S', "2"}, {"a", 'S', "3"},
                          {"z", 'S', "4"}, {"m", 'S', "5"}, {"b", 'S', "6"}};
    const MessageHeaders headers = HeadersFromAmqp(properties, "", "ctag", 1);
    std::vector<std::string> table;
    for (const auto& [key, value] : headers.headers) table.push_back(key + "=" + value);
    EXPECT_EQ(table, (std::vector<std::string>{"ConsumerTag=ctag", "DeliveryTag=1",
                                               "Persistent=false", "a=3", "b=6", "m=5", "z=4"}));
}

TEST(AmqpPropertyMapping, ReceiveIgnoresPropertiesWhoseFlagIsClear) {
    AmqpProperties properties;
    properties.type = "Stale";
    properties.correlationId = "stale";
    properties.timestamp = 5000;
    properties.headers = {{"Stale", 'S', "1"}};
    const MessageHeaders headers = HeadersFromAmqp(properties, "key", "", 1);
    EXPECT_EQ(headers.messageType, "");
    EXPECT_EQ(headers.correlationId, "");
    EXPECT_TRUE(headers.timestamp.is_not_a_date_time());
    EXPECT_EQ(headers.GetHeader("Stale"), nullptr);
}

TEST(AmqpPropertyMapping, SentHeadersArriveWithTheLocalOnesAdded) {
    MessageHeaders sent = SampleHeaders();
    sent.SetPersistent(false);
    sent.SetReplyTo("client_q");
    const MessageHeaders received =
        HeadersFromAmqp(ToAmqpProperties(sent, 1), sent.routingKey, "ctag", 3);
    EXPECT_EQ(received.messageType, sent.messageType);
    EXPECT_EQ(received.contentType, sent.contentType);
    EXPECT_EQ(received.correlationId, sent.correlationId);
    EXPECT_EQ(received.routingKey, sent.routingKey);
    EXPECT_EQ(received.ReplyTo(), "client_q");
    // The sender's "0" travels in the table; the delivery mode it asked for wins.
    EXPECT_EQ(*received.GetHeader(HeaderKeys::kPersistent), "true");
    MessageHeaders expected = sent;
    expected.SetHeader(HeaderKeys::kPersistent, "true");
    expected.SetHeader(HeaderKeys::kConsumerTag, "ctag");
    expected.SetDeliveryTag(3);
    EXPECT_EQ(received.headers, expected.headers);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
