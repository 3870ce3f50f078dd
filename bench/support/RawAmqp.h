#pragma once

#include <amqp.h>

#include "support/BenchBroker.h"

namespace Korvane::Veldra::Bench {

// Throws std::runtime_error("rabbitmq-c failed: <step>") unless the reply is
// a normal one.
void CheckRawReply(const amqp_rpc_reply_t& reply, const char* step);

// A rabbitmq-c connection to the broker, logged in, with channel 1 open;
// throws std::runtime_error when the broker refuses.
amqp_connection_state_t OpenRawConnection(const BrokerAddress& broker);

// Closes channel 1 and the connection, and frees it.
void CloseRawConnection(amqp_connection_state_t state);

}  // namespace Korvane::Veldra::Bench
