#include <gtest/gtest.h>

#include <string>

#include "messagebus/amqp/AmqpConnection.h"
#include "messagebus/amqp/AmqpReplyText.h"

namespace Korvane::Veldra::MessageBus {
namespace {

amqp_rpc_reply_t Reply(int type, int libraryError = 0, amqp_method_number_t method = 0) {
    amqp_rpc_reply_t reply{};
    reply.reply_type = static_cast<amqp_response_type_enum>(type);
    reply.library_error = libraryError;
    reply.reply.id = method;
    return reply;
}

TEST(AmqpReplyText, EachReplyTypeHasItsText) {
    struct Case {
        amqp_rpc_reply_t reply;
        std::string text;
    };
    const Case cases[] = {
        {Reply(AMQP_RESPONSE_NONE), "No AMQP Response"},
        {Reply(AMQP_RESPONSE_NORMAL), "Normal AMQP Response"},
        {Reply(AMQP_RESPONSE_LIBRARY_EXCEPTION, AMQP_STATUS_SOCKET_ERROR),
         "AMQP Client Error Code: -9. Description: " +
             std::string(amqp_error_string2(AMQP_STATUS_SOCKET_ERROR))},
        {Reply(AMQP_RESPONSE_SERVER_EXCEPTION, 0, AMQP_CHANNEL_CLOSE_METHOD),
         "AMQP Server Exception. Method Id: 1310760"},
        {Reply(7), "Unknown AMQP reply type. Value: 7"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(AmqpReplyText(c.reply), c.text);
        EXPECT_EQ(AmqpConnection::ReplyText(c.reply), c.text);
    }
    EXPECT_EQ(AmqpNoReply().reply_type, AMQP_RESPONSE_NONE);
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
