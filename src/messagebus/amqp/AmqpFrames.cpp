#include "messagebus/amqp/AmqpFrames.h"

#include "messagebus/amqp/AmqpPropertiesC.h"

namespace Korvane::Veldra::MessageBus {

std::string BytesText(const amqp_bytes_t& bytes) {
    if (bytes.bytes == nullptr || bytes.len == 0) return std::string();
    return std::string(static_cast<const char*>(bytes.bytes), bytes.len);
}

amqp_bytes_t TextBytes(const std::string& text) {
    amqp_bytes_t bytes;
    bytes.len = text.size();
    bytes.bytes = const_cast<char*>(text.data());
    return bytes;
}

std::string ReturnedMessageText(const std::string& messageType, const std::string& correlationId) {
    return "Publish failed:  The message with mandatory routing could not be delivered. "
           "Message type: " +
           messageType + ", correlation id: " + correlationId;
}

ResetEvent ReturnEventFor(const amqp_basic_properties_t& properties) {
    const AmqpProperties read = FromAmqpBasicProperties(properties);
    return ResetEvent{read.correlationId, ReturnedMessageText(read.type, read.correlationId)};
}

std::optional<ResetEvent> ReadReturnedMessage(amqp_connection_state_t connection,
                                              amqp_channel_t channel) {
    amqp_message_t message{};
    const amqp_rpc_reply_t reply = amqp_read_message(connection, channel, &message, 0);
    // A failed read releases what it had taken itself.
    if (reply.reply_type != AMQP_RESPONSE_NORMAL) return std::nullopt;
    std::optional<ResetEvent> event;
    try {
        event = ReturnEventFor(message.properties);
    } catch (...) {
        amqp_destroy_message(&message);
        throw;
    }
    amqp_destroy_message(&message);
    return event;
}

std::string LibraryExceptionLine(int status) {
    return "RabbitMQ client library exception: " + std::to_string(status) +
           ", Description: " + amqp_error_string2(status);
}

std::string UnexpectedMethodLine(amqp_method_number_t method) {
    return "An unexpected AMQP method was received: " + std::to_string(method);
}

std::string NoConsumerLine(const std::string& connectionName, amqp_channel_t channel) {
    return "The " + connectionName + " has no consumer for channel: " + std::to_string(channel) +
           ". We should send a NO_ACK for this message.";
}

}  // namespace Korvane::Veldra::MessageBus
