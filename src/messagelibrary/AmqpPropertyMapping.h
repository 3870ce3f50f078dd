#pragma once

#include <cstdint>
#include <string>

#include "messagelibrary/AmqpProperties.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {

// The properties of an outgoing message: content type, timestamp (the given
// wall clock in whole seconds; the headers' own timestamp is not sent), type,
// correlation id, the whole header table as long strings in key order (also
// when it is empty) and, only when the table has a "Persistent" key whatever
// its value, delivery mode 2. Nothing else is set.
AmqpProperties ToAmqpProperties(const MessageHeaders& headers, int64_t nowUnixSeconds);
// The same with the current wall clock.
AmqpProperties ToAmqpProperties(const MessageHeaders& headers);

// The headers of a received message. The timestamp property is taken as
// milliseconds (while senders write seconds), the correlation id ends at its
// first zero byte, every entry of the header table is copied as bytes, then
// the local values replace what the sender's table held under their keys:
// "Persistent" is "true" or "false" from the delivery mode, "ConsumerTag" is
// the local consumer's tag and "DeliveryTag" the low 32 bits of the delivery
// tag.
MessageHeaders HeadersFromAmqp(AmqpProperties properties, const std::string& routingKey,
                               const std::string& consumerTag, uint64_t deliveryTag);

}  // namespace Korvane::Veldra::MessageBus
