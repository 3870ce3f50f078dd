#pragma once

#include <amqp.h>

#include <optional>
#include <string>

#include "messagebus/concurrency/ResetEvent.h"

namespace Korvane::Veldra::MessageBus {

// The methods a reader thread acts on when a frame other than a delivery
// waits on its connection.
namespace AmqpMethodIds {
constexpr amqp_method_number_t kChannelClose = 0x00140028;
constexpr amqp_method_number_t kConnectionClose = 0x000A0032;
constexpr amqp_method_number_t kBasicReturn = 0x003C0032;
constexpr amqp_method_number_t kBasicAck = 0x003C0050;
}  // namespace AmqpMethodIds

// The bytes as text; empty for a null block.
std::string BytesText(const amqp_bytes_t& bytes);
// A view of the text's bytes for a rabbitmq-c call that only reads them.
amqp_bytes_t TextBytes(const std::string& text);

// The text given to the waiter of a mandatory publish that came back.
std::string ReturnedMessageText(const std::string& messageType, const std::string& correlationId);
// The notice of a returned message, from its properties.
ResetEvent ReturnEventFor(const amqp_basic_properties_t& properties);
// Reads the content of a basic.return that waits on the channel and makes its
// notice; none when the content could not be read.
std::optional<ResetEvent> ReadReturnedMessage(amqp_connection_state_t connection,
                                              amqp_channel_t channel);

// The log lines of the reader threads.
std::string LibraryExceptionLine(int status);
std::string UnexpectedMethodLine(amqp_method_number_t method);
// connectionName is "publisher connection" or "connection manager".
std::string NoConsumerLine(const std::string& connectionName, amqp_channel_t channel);

}  // namespace Korvane::Veldra::MessageBus
