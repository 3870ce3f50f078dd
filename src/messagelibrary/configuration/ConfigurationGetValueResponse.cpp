#include "messagelibrary/configuration/ConfigurationGetValueResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetValueResponse::ConfigurationGetValueResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<std::string> value)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      value_(std::move(value)) {
    AnswerTo(request, std::nullopt);
}

ConfigurationGetValueResponse::ConfigurationGetValueResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

ConfigurationGetValueResponse::ConfigurationGetValueResponse(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetValueResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
