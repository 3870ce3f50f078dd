#include "messagelibrary/configuration/ConfigurationGetKeysResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetKeysResponse::ConfigurationGetKeysResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<JsonStringMap> keys)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      keys_(std::move(keys)) {
    AnswerTo(request, std::nullopt);
}

ConfigurationGetKeysResponse::ConfigurationGetKeysResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

ConfigurationGetKeysResponse::ConfigurationGetKeysResponse(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetKeysResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
