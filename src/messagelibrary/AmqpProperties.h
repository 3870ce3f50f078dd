#pragma once

#include <cstdint>
#include <string>
#include <vector>

namespace Korvane::Veldra::MessageBus {

// The bits of the basic-properties flag word that this library reads or
// writes; the values are those of AMQP 0-9-1 (and of rabbitmq-c's
// AMQP_BASIC_*_FLAG macros).
namespace AmqpPropertyFlags {
constexpr uint32_t kContentType = 1u << 15;
constexpr uint32_t kHeaders = 1u << 13;
constexpr uint32_t kDeliveryMode = 1u << 12;
constexpr uint32_t kCorrelationId = 1u << 10;
constexpr uint32_t kTimestamp = 1u << 6;
constexpr uint32_t kType = 1u << 5;
}  // namespace AmqpPropertyFlags

// The field kind of a long string in an AMQP table.
constexpr char kAmqpLongStringKind = 'S';

// One entry of the properties' header table. The bytes of key and value are
// copied as they stand; kind is the AMQP field kind.
struct AmqpHeaderEntry {
    std::string key;
    char kind = kAmqpLongStringKind;
    std::string value;
};

// The subset of AMQP basic properties that messages use, one field for each
// property of the wire record: flags is its flag word, and a field whose flag
// is clear is neither sent nor read. Texts hold raw bytes.
struct AmqpProperties {
    uint32_t flags = 0;
    std::string contentType;
    std::vector<AmqpHeaderEntry> headers;
    uint8_t deliveryMode = 0;
    std::string correlationId;
    uint64_t timestamp = 0;
    std::string type;
};

}  // namespace Korvane::Veldra::MessageBus
