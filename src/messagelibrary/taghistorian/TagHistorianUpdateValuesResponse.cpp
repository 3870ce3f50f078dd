#include "messagelibrary/taghistorian/TagHistorianUpdateValuesResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianUpdateValuesResponse::TagHistorianUpdateValuesResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<ErrorRecord> errors)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      errors_(std::move(errors)) {
    AnswerTo(request, std::nullopt);
}

TagHistorianUpdateValuesResponse::TagHistorianUpdateValuesResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHistorianUpdateValuesResponse::TagHistorianUpdateValuesResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianUpdateValuesResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
