#include "messagebus/amqp/EnvelopeHeaders.h"

#include "messagebus/amqp/AmqpFrames.h"
#include "messagebus/amqp/AmqpPropertiesC.h"
#include "messagelibrary/AmqpPropertyMapping.h"

namespace Korvane::Veldra::MessageBus {

MessageHeaders HeadersFromEnvelope(const amqp_envelope_t& envelope,
                                   const std::string& consumerTag) {
    return HeadersFromAmqp(FromAmqpBasicProperties(envelope.message.properties),
                           BytesText(envelope.routing_key), consumerTag, envelope.delivery_tag);
}

std::string CorrelationIdOf(const amqp_envelope_t& envelope) {
    const amqp_basic_properties_t& properties = envelope.message.properties;
    if ((properties._flags & AMQP_BASIC_CORRELATION_ID_FLAG) == 0 ||
        properties.correlation_id.bytes == nullptr) {
        return std::string();
    }
    const auto* text = static_cast<const char*>(properties.correlation_id.bytes);
    const std::string correlationId(text, properties.correlation_id.len);
    return correlationId.substr(0, correlationId.find('\0'));
}

std::string MessageTypeOf(const amqp_envelope_t& envelope) {
    const amqp_basic_properties_t& properties = envelope.message.properties;
    if ((properties._flags & AMQP_BASIC_TYPE_FLAG) == 0 || properties.type.bytes == nullptr) {
        return std::string();
    }
    return BytesText(properties.type);
}

std::shared_ptr<GenericMessage> MessageFromEnvelope(const amqp_envelope_t& envelope,
                                                    const std::string& consumerTag) {
    const amqp_bytes_t& body = envelope.message.body;
    return std::make_shared<GenericMessage>(
        HeadersFromEnvelope(envelope, consumerTag),
        MessageBody(static_cast<const char*>(body.bytes), body.bytes != nullptr ? body.len : 0));
}

}  // namespace Korvane::Veldra::MessageBus
