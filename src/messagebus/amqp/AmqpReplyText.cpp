#include "messagebus/amqp/AmqpReplyText.h"

#include <cstring>

namespace Korvane::Veldra::MessageBus {

std::string AmqpReplyText(const amqp_rpc_reply_t& reply) {
    // The reply type is read as a plain number: a value outside the enumeration
    // (which the last case reports) must not be loaded as the enumeration.
    int type = 0;
    static_assert(sizeof type == sizeof reply.reply_type);
    std::memcpy(&type, &reply.reply_type, sizeof type);
    switch (type) {
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
            return "Unknown AMQP reply type. Value: " + std::to_string(type);
    }
}

amqp_rpc_reply_t AmqpNoReply() {
    amqp_rpc_reply_t reply{};
    reply.reply_type = AMQP_RESPONSE_NONE;
    return reply;
}

}  // namespace Korvane::Veldra::MessageBus
