#include "messagelibrary/taghistorian/TagHistorianAsyncUnsubscribeResponse.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncUnsubscribeResponse::TagHistorianAsyncUnsubscribeResponse(
    const MessageBus::Interfaces::IRoutingSource& request)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, std::nullopt);
}

TagHistorianAsyncUnsubscribeResponse::TagHistorianAsyncUnsubscribeResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagHistorianAsyncUnsubscribeResponse::TagHistorianAsyncUnsubscribeResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncUnsubscribeResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
