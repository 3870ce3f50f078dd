#include "messagelibrary/taghttp/TagHttpGetSelectionResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpGetSelectionResponse::TagHttpGetSelectionResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<TagSelection> selection)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      selection_(std::move(selection)) {
    AnswerTo(request, std::nullopt);
}

TagHttpGetSelectionResponse::TagHttpGetSelectionResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHttpGetSelectionResponse::TagHttpGetSelectionResponse(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpGetSelectionResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
