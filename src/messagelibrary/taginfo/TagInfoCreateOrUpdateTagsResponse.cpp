#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoCreateOrUpdateTagsResponse::TagInfoCreateOrUpdateTagsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<ErrorRecord> errors)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      errors_(std::move(errors)) {
    AnswerTo(request, std::nullopt);
}

TagInfoCreateOrUpdateTagsResponse::TagInfoCreateOrUpdateTagsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagInfoCreateOrUpdateTagsResponse::TagInfoCreateOrUpdateTagsResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoCreateOrUpdateTagsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
