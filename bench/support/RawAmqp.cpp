#include "support/RawAmqp.h"

#include <amqp_tcp_socket.h>

#include <stdexcept>
#include <string>

namespace Korvane::Veldra::Bench {
void CheckRawReply(const amqp_rpc_reply_t& reply, const char* step) {
    if (reply.reply_type != AMQP_RESPONSE_NORMAL) {
        throw std::runtime_error(std::string("rabbitmq-c failed: ") + step);
    }
}

amqp_connection_state_t OpenRawConnection(const BrokerAddress& broker) {
    amqp_connection_state_t state = amqp_new_connection();
    amqp_socket_t* socket = amqp_tcp_socket_new(state);
    if (socket == nullptr || amqp_socket_open(socket, broker.host.c_str(), broker.port) != 0) {
        amqp_destroy_connection(state);
        throw std::runtime_error("cannot open a socket to the broker");
    }
    try {
        CheckRawReply(amqp_login(state, "/", 0, 131072, 0, AMQP_SASL_METHOD_PLAIN, broker.user.c_str(),
                         broker.password.c_str()),
              "login");
        amqp_channel_open(state, 1);
        CheckRawReply(amqp_get_rpc_reply(state), "channel.open");
    } catch (...) {
        amqp_destroy_connection(state);
        throw;
    }
    return state;
}

void CloseRawConnection(amqp_connection_state_t state) {
    amqp_channel_close(state, 1, AMQP_REPLY_SUCCESS);
    amqp_connection_close(state, AMQP_REPLY_SUCCESS);
    amqp_destroy_connection(state);
}

}  // namespace Korvane::Veldra::Bench
