#include "messagelibrary/taghttp/TagHttpGetSelectionsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpGetSelectionsResponse::TagHttpGetSelectionsResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<TagSelection>> selections)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      selections_(std::move(selections)) {
    AnswerTo(request, std::nullopt);
}

TagHttpGetSelectionsResponse::TagHttpGetSelectionsResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHttpGetSelectionsResponse::TagHttpGetSelectionsResponse(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpGetSelectionsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
