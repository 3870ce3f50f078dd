#include <amqp.h>
#include <gtest/gtest.h>

#include <string>

#include "support/BrokerEnvironment.h"
#include "support/RawAmqpConnection.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr amqp_channel_t kChannel = 1;

std::string BytesText(const amqp_bytes_t& bytes) {
    return std::string(static_cast<const char*>(bytes.bytes), bytes.len);
}

// Declares a server-named, exclusive queue and returns its name.
std::string DeclareQueue(RawAmqpConnection& connection) {
    const amqp_queue_declare_ok_t* ok = amqp_queue_declare(
        connection.Get(), kChannel, amqp_empty_bytes, 0, 0, 1, 1, amqp_empty_table);
    EXPECT_TRUE(IsNormal(amqp_get_rpc_reply(connection.Get())));
    return ok != nullptr ? BytesText(ok->queue) : std::string();
}

TEST(BrokerSmoke, PublishesAndGetsAMessageOverPlainAmqp) {
    RawAmqpConnection connection;
    ASSERT_EQ(connection.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    ASSERT_TRUE(connection.Login(Broker().User, Broker().Password));
    ASSERT_TRUE(connection.OpenChannel(kChannel));
    const std::string queue = DeclareQueue(connection);
    ASSERT_FALSE(queue.empty());

    const std::string body = "{\"greeting\":\"hello from the harness\"}";
    amqp_basic_properties_t properties{};
    properties._flags = AMQP_BASIC_CONTENT_TYPE_FLAG;
    properties.content_type = amqp_cstring_bytes("application/json");
    ASSERT_EQ(amqp_basic_publish(connection.Get(), kChannel, amqp_empty_bytes,
                                 amqp_cstring_bytes(queue.c_str()), 0, 0, &properties,
                                 amqp_cstring_bytes(body.c_str())),
              AMQP_STATUS_OK);

    // The channel hands the publish to the queue before the get, so the get
    // finds the message without waiting.
    const amqp_rpc_reply_t got =
        amqp_basic_get(connection.Get(), kChannel, amqp_cstring_bytes(queue.c_str()), 1);
    ASSERT_TRUE(IsNormal(got));
    ASSERT_EQ(got.reply.id, AMQP_BASIC_GET_OK_METHOD);

    amqp_message_t message;
    ASSERT_TRUE(IsNormal(amqp_read_message(connection.Get(), kChannel, &message, 0)));
    EXPECT_EQ(BytesText(message.body), body);
    ASSERT_TRUE(message.properties._flags & AMQP_BASIC_CONTENT_TYPE_FLAG);
    EXPECT_EQ(BytesText(message.properties.content_type), "application/json");
    amqp_destroy_message(&message);

    EXPECT_TRUE(IsNormal(amqp_channel_close(connection.Get(), kChannel, AMQP_REPLY_SUCCESS)));
}

TEST(BrokerSmoke, RefusesAWrongPassword) {
    RawAmqpConnection connection;
    ASSERT_EQ(connection.OpenTcp(Broker().Host, Broker().AmqpPort), AMQP_STATUS_OK);
    EXPECT_FALSE(connection.Login(Broker().User, Broker().Password + "-wrong"));
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
