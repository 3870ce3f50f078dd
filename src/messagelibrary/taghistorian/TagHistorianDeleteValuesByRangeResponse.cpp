#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByRangeResponse.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianDeleteValuesByRangeResponse::TagHistorianDeleteValuesByRangeResponse(
    const MessageBus::Interfaces::IRoutingSource& request)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, std::nullopt);
}

TagHistorianDeleteValuesByRangeResponse::TagHistorianDeleteValuesByRangeResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHistorianDeleteValuesByRangeResponse::TagHistorianDeleteValuesByRangeResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianDeleteValuesByRangeResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
