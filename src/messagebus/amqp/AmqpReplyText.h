#pragma once

#include <amqp.h>

#include <string>

namespace Korvane::Veldra::MessageBus {

// The text form of an RPC reply, as the failure texts of the AMQP layer end:
// "No AMQP Response", "Normal AMQP Response", the client error with its
// description, the server exception with its method id, or the unknown type.
std::string AmqpReplyText(const amqp_rpc_reply_t& reply);

// A reply that says nothing arrived, for calls made without a connection.
amqp_rpc_reply_t AmqpNoReply();

}  // namespace Korvane::Veldra::MessageBus
