#include <gtest/gtest.h>

#include <string>

#include "messagebus/amqp/AmqpFrames.h"
#include "messagebus/amqp/EnvelopeHeaders.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using namespace std::string_literals;

// A delivery as rabbitmq-c fills it, over storage owned by the test.
class HandBuiltEnvelope {
public:
    HandBuiltEnvelope() {
        entries_[0].key = amqp_cstring_bytes("ReplyTo");
        entries_[0].value.kind = AMQP_FIELD_KIND_UTF8;
        entries_[0].value.value.bytes = TextBytes(replyTo_);
        entries_[1].key = amqp_cstring_bytes("Blob");
        entries_[1].value.kind = AMQP_FIELD_KIND_BYTES;
        entries_[1].value.value.bytes = TextBytes(blob_);
        // A kind this system never sends: its bytes are not a string.
        entries_[2].key = amqp_cstring_bytes("Nested");
        entries_[2].value.kind = AMQP_FIELD_KIND_TABLE;
        entries_[2].value.value.table.num_entries = 1;
        entries_[2].value.value.table.entries = &entries_[0];

        amqp_basic_properties_t& properties = envelope.message.properties;
        properties._flags = AMQP_BASIC_CONTENT_TYPE_FLAG | AMQP_BASIC_TYPE_FLAG |
                            AMQP_BASIC_CORRELATION_ID_FLAG | AMQP_BASIC_TIMESTAMP_FLAG |
                            AMQP_BASIC_DELIVERY_MODE_FLAG | AMQP_BASIC_HEADERS_FLAG;
        properties.content_type = amqp_cstring_bytes("application/json");
        properties.type = amqp_cstring_bytes("TagInfoQueryTagsResponse");
        properties.correlation_id = TextBytes(correlationId_);
        properties.timestamp = 1700000000123ull;
        properties.delivery_mode = 2;
        properties.headers.num_entries = 3;
        properties.headers.entries = entries_;
        envelope.routing_key = amqp_cstring_bytes("Veldra.abc_1234.TagInfoQueryTagsResponse");
        envelope.delivery_tag = (1ull << 32) + 7;
        envelope.message.body = TextBytes(body_);
    }

    amqp_envelope_t envelope{};

private:
    const std::string replyTo_ = "abc_1234";
    const std::string blob_ = "a\0b"s;
    const std::string correlationId_ = "corr-1\0trailing"s;
    const std::string body_ = "{\"RequestName\":\"X\"}";
    amqp_table_entry_t entries_[3] = {};
};

TEST(EnvelopeHeaders, DeliveryBecomesTheReceivedHeaders) {
    const HandBuiltEnvelope delivery;
    const MessageHeaders headers = HeadersFromEnvelope(delivery.envelope, "");

    EXPECT_EQ(headers.routingKey, "Veldra.abc_1234.TagInfoQueryTagsResponse");
    EXPECT_EQ(headers.messageType, "TagInfoQueryTagsResponse");
    EXPECT_EQ(headers.contentType, "application/json");
    EXPECT_EQ(headers.correlationId, "corr-1");  // cut at the zero byte
    // The property is read as milliseconds.
    EXPECT_TRUE(headers.timestamp == VeldraMessageLibrary::TimestampFromUnixSeconds(1700000000));
    EXPECT_EQ(headers.HeaderOrEmpty("Persistent"), "true");
    ASSERT_NE(headers.GetHeader("ConsumerTag"), nullptr);
    EXPECT_EQ(*headers.GetHeader("ConsumerTag"), "");
    EXPECT_EQ(headers.HeaderOrEmpty("ReplyTo"), "abc_1234");
    EXPECT_EQ(headers.HeaderOrEmpty("Blob"), "a\0b"s);
    ASSERT_NE(headers.GetHeader("Nested"), nullptr);
    EXPECT_EQ(*headers.GetHeader("Nested"), "");
    EXPECT_EQ(headers.DeliveryTag(), 7u);  // the low 32 bits
}

TEST(EnvelopeHeaders, MessageOwnsACopyOfTheBody) {
    const HandBuiltEnvelope delivery;
    const auto message = MessageFromEnvelope(delivery.envelope, "");
    EXPECT_EQ(message->Body().ToString(), "{\"RequestName\":\"X\"}");
    EXPECT_NE(message->Body().Data(), delivery.envelope.message.body.bytes);
    EXPECT_EQ(message->MessageType(), "TagInfoQueryTagsResponse");

    HandBuiltEnvelope empty;
    empty.envelope.message.body = amqp_empty_bytes;
    EXPECT_TRUE(MessageFromEnvelope(empty.envelope, "")->Body().Empty());
}

TEST(ReturnedMessage, NoticeCarriesTheExactText) {
    amqp_basic_properties_t properties{};
    properties._flags = AMQP_BASIC_TYPE_FLAG | AMQP_BASIC_CORRELATION_ID_FLAG;
    properties.type = amqp_cstring_bytes("TagInfoQueryTagsRequest");
    properties.correlation_id = amqp_cstring_bytes("0f6e");
    const ResetEvent event = ReturnEventFor(properties);
    EXPECT_EQ(event.CorrelationId, "0f6e");
    EXPECT_EQ(event.Message,
              "Publish failed:  The message with mandatory routing could not be delivered. "
              "Message type: TagInfoQueryTagsRequest, correlation id: 0f6e");

    // Properties whose flags are clear are not read.
    properties._flags = 0;
    EXPECT_EQ(ReturnEventFor(properties).Message,
              "Publish failed:  The message with mandatory routing could not be delivered. "
              "Message type: , correlation id: ");
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
