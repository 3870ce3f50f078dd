#include "messagelibrary/taghistorian/TagHistorianQueryResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianQueryResponse::TagHistorianQueryResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<HistorianValues> tagHistorianValues)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      tagHistorianValues_(std::move(tagHistorianValues)) {
    AnswerTo(request, std::nullopt);
}

TagHistorianQueryResponse::TagHistorianQueryResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHistorianQueryResponse::TagHistorianQueryResponse(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianQueryResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
