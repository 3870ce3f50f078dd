#include "messagelibrary/AmqpPropertyMapping.h"

#include <ctime>
#include <utility>

#include "messagelibrary/HeaderKeys.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr uint8_t kPersistentDeliveryMode = 2;

bool HasFlag(const AmqpProperties& properties, uint32_t flag) {
    return (properties.flags & flag) != 0;
}

// The text of a flagged property, or empty when its flag is clear.
const std::string& FlaggedText(const AmqpProperties& properties, uint32_t flag,
                               const std::string& text) {
    static const std::string kEmpty;
    return HasFlag(properties, flag) ? text : kEmpty;
}

}  // namespace

AmqpProperties ToAmqpProperties(const MessageHeaders& headers, int64_t nowUnixSeconds) {
    using namespace AmqpPropertyFlags;
    AmqpProperties properties;
    properties.flags = kContentType | kTimestamp | kType | kCorrelationId | kHeaders;
    properties.contentType = headers.contentType;
    properties.timestamp = static_cast<uint64_t>(nowUnixSeconds);
    properties.type = headers.messageType;
    properties.correlationId = headers.correlationId;
    properties.headers.reserve(headers.headers.size());
    for (const auto& [key, value] : headers.headers) {
        properties.headers.push_back(AmqpHeaderEntry{key, kAmqpLongStringKind, value});
    }
    if (headers.GetHeader(HeaderKeys::kPersistent) != nullptr) {
        properties.flags |= kDeliveryMode;
        properties.deliveryMode = kPersistentDeliveryMode;
    }
    return properties;
}

AmqpProperties ToAmqpProperties(const MessageHeaders& headers) {
    return ToAmqpProperties(headers, static_cast<int64_t>(std::time(nullptr)));
}

MessageHeaders HeadersFromAmqp(AmqpProperties properties, const std::string& routingKey,
                               const std::string& consumerTag, uint64_t deliveryTag) {
    using namespace AmqpPropertyFlags;
    MessageHeaders headers;
    // The record is ours: its texts move over rather than being copied.
    if (HasFlag(properties, kType)) headers.messageType = std::move(properties.type);
    if (HasFlag(properties, kContentType)) headers.contentType = std::move(properties.contentType);
    headers.routingKey = routingKey;
    if (HasFlag(properties, kTimestamp)) {
        const auto seconds = static_cast<int32_t>(properties.timestamp / 1000u);
        headers.timestamp = VeldraMessageLibrary::TimestampFromUnixSeconds(seconds);
    }
    const std::string& correlationId =
        FlaggedText(properties, kCorrelationId, properties.correlationId);
    headers.correlationId = correlationId.substr(0, correlationId.find('\0'));

    if (HasFlag(properties, kHeaders)) {
        // A repeated key keeps its last value. A sender's table comes in key
        // order (this library writes it from the map), so each entry is
        // offered at the end first: one comparison instead of a search.
        for (auto& entry : properties.headers) {
            headers.headers.insert_or_assign(headers.headers.end(), std::move(entry.key),
                                             std::move(entry.value));
        }
    }
    // The values computed here are written after the sender's table on
    // purpose: a message re-published with the headers it was received with
    // carries the first receiver's consumer tag, and with that tag a manual
    // acknowledgement would find no consumer and do nothing.
    const bool persistent =
        properties.flags != 0 && properties.deliveryMode == kPersistentDeliveryMode;
    headers.SetHeader(HeaderKeys::kPersistent, std::string(persistent ? "true" : "false"));
    headers.SetHeader(HeaderKeys::kConsumerTag, consumerTag);
    headers.SetDeliveryTag(deliveryTag);
    return headers;
}

}  // namespace Korvane::Veldra::MessageBus
