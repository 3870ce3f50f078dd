#include "messagebus/AmqpReplyText.h"

namespace Korvane::Veldra::MessageBus {

std::string AmqpReplyText(const amqp_rpc_reply_t& reply) {
    switch (static_cast<int>(reply.reply_type)) {
        case AMQP_RESPONSE_NONE:
            return "No AMQP Response";
        case AMQP_RESPONSE_NORMAL:
            return "Normal AMQP Response";
        case AMQP_RESPONSE_LIBRARY_EXCEPTION:
            return "AMQP Client Error Code: " + std::to_string(reply.library_error) +
                   ". Description: " + amqp_error_string2(reply.library_error);
        case AMQP_RESPONSE_SERVER_EXCEPTION:
            return "AMQP Server Exception. Method Id: " + std::to_string(reply.reply.id);
        default:
            return "Unknown AMQP reply type. Value: " +
                   std::to_string(static_cast<int>(reply.reply_type));
    }
}

amqp_rpc_reply_t AmqpNoReply() {
    amqp_rpc_reply_t reply{};
    reply.reply_type = AMQP_RESPONSE_NONE;
    return reply;
}

}  // namespace Korvane::Veldra::MessageBus
