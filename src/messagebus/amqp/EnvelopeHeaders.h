#pragma once

#include <amqp.h>

#include <memory>
#include <string>

#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {

// The headers of a delivery: type, content type and routing key by their
// lengths, the correlation id up to its first zero byte, the timestamp read
// as milliseconds, every entry of the header table, then the local
// "Persistent" from the delivery mode, "ConsumerTag", and "DeliveryTag" from
// the envelope, which win over table entries of the same keys.
MessageHeaders HeadersFromEnvelope(const amqp_envelope_t& envelope, const std::string& consumerTag);

// The correlation id and the message type the headers would have: empty
// without them.
std::string CorrelationIdOf(const amqp_envelope_t& envelope);
std::string MessageTypeOf(const amqp_envelope_t& envelope);

// The received message: those headers and a copy of the body, so that it
// outlives the envelope.
std::shared_ptr<GenericMessage> MessageFromEnvelope(const amqp_envelope_t& envelope,
                                                    const std::string& consumerTag);

}  // namespace Korvane::Veldra::MessageBus
