#include "messagebus/amqp/AmqpPropertiesC.h"

#include <algorithm>
#include <cstddef>
#include <string>

namespace Korvane::Veldra::MessageBus {
namespace {

amqp_bytes_t BytesOf(const std::string& text) {
    amqp_bytes_t bytes;
    bytes.len = text.size();
    bytes.bytes = const_cast<char*>(text.data());
    return bytes;
}

std::string TextOf(const amqp_bytes_t& bytes) {
    if (bytes.bytes == nullptr) return std::string();
    return std::string(static_cast<const char*>(bytes.bytes), bytes.len);
}

// A header value of a foreign sender, in the text form this library reads.
std::string ValueText(const amqp_field_value_t& value) {
    switch (value.kind) {
        case AMQP_FIELD_KIND_UTF8:
        case AMQP_FIELD_KIND_BYTES:
            return TextOf(value.value.bytes);
        case AMQP_FIELD_KIND_BOOLEAN:
            return value.value.boolean ? "true" : "false";
        case AMQP_FIELD_KIND_I8:
            return std::to_string(value.value.i8);
        case AMQP_FIELD_KIND_U8:
            return std::to_string(value.value.u8);
        case AMQP_FIELD_KIND_I16:
            return std::to_string(value.value.i16);
        case AMQP_FIELD_KIND_U16:
            return std::to_string(value.value.u16);
        case AMQP_FIELD_KIND_I32:
            return std::to_string(value.value.i32);
        case AMQP_FIELD_KIND_U32:
            return std::to_string(value.value.u32);
        case AMQP_FIELD_KIND_I64:
            return std::to_string(value.value.i64);
        case AMQP_FIELD_KIND_U64:
        case AMQP_FIELD_KIND_TIMESTAMP:
            return std::to_string(value.value.u64);
        default:
            return std::string();
    }
}

}  // namespace

AmqpBasicProperties::AmqpBasicProperties(const AmqpProperties& properties) : properties_{} {
    // Only the properties the record holds can be sent.
    constexpr uint32_t kRecordFlags =
        AMQP_BASIC_CONTENT_TYPE_FLAG | AMQP_BASIC_HEADERS_FLAG | AMQP_BASIC_DELIVERY_MODE_FLAG |
        AMQP_BASIC_CORRELATION_ID_FLAG | AMQP_BASIC_TIMESTAMP_FLAG | AMQP_BASIC_TYPE_FLAG;
    properties_._flags = static_cast<amqp_flags_t>(properties.flags & kRecordFlags);
    properties_.content_type = BytesOf(properties.contentType);
    properties_.delivery_mode = properties.deliveryMode;
    properties_.correlation_id = BytesOf(properties.correlationId);
    properties_.timestamp = properties.timestamp;
    properties_.type = BytesOf(properties.type);
    entries_.reserve(properties.headers.size());
    for (const AmqpHeaderEntry& header : properties.headers) {
        amqp_table_entry_t entry{};
        entry.key = BytesOf(header.key);
        // Every header travels as a string, whatever kind the record says.
        entry.value.kind = AMQP_FIELD_KIND_UTF8;
        entry.value.value.bytes = BytesOf(header.value);
        entries_.push_back(entry);
    }
    properties_.headers.num_entries = static_cast<int>(entries_.size());
    properties_.headers.entries = entries_.empty() ? nullptr : entries_.data();
}

AmqpProperties FromAmqpBasicProperties(const amqp_basic_properties_t& properties) {
    AmqpProperties record;
    const uint32_t flags = properties._flags;
    record.flags = flags;
    if (flags & AMQP_BASIC_CONTENT_TYPE_FLAG) record.contentType = TextOf(properties.content_type);
    if (flags & AMQP_BASIC_DELIVERY_MODE_FLAG) record.deliveryMode = properties.delivery_mode;
    if (flags & AMQP_BASIC_CORRELATION_ID_FLAG) {
        record.correlationId = TextOf(properties.correlation_id);
    }
    if (flags & AMQP_BASIC_TIMESTAMP_FLAG) record.timestamp = properties.timestamp;
    if (flags & AMQP_BASIC_TYPE_FLAG) record.type = TextOf(properties.type);
    if ((flags & AMQP_BASIC_HEADERS_FLAG) && properties.headers.entries != nullptr) {
        record.headers.reserve(
            static_cast<std::size_t>(std::max(0, properties.headers.num_entries)));
        for (int i = 0; i < properties.headers.num_entries; ++i) {
            const amqp_table_entry_t& entry = properties.headers.entries[i];
            record.headers.push_back(AmqpHeaderEntry{
                TextOf(entry.key), static_cast<char>(entry.value.kind), ValueText(entry.value)});
        }
    }
    return record;
}

}  // namespace Korvane::Veldra::MessageBus
