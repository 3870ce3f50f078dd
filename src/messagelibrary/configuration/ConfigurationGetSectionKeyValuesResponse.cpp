#include "messagelibrary/configuration/ConfigurationGetSectionKeyValuesResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

ConfigurationGetSectionKeyValuesResponse::ConfigurationGetSectionKeyValuesResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<ConfigurationSectionKeyValues>> keyValues)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      keyValues_(std::move(keyValues)) {
    AnswerTo(request, std::nullopt);
}

ConfigurationGetSectionKeyValuesResponse::ConfigurationGetSectionKeyValuesResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

ConfigurationGetSectionKeyValuesResponse::ConfigurationGetSectionKeyValuesResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ConfigurationGetSectionKeyValuesResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
