#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorUnsubscribeResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorUnsubscribeResponse::TagSubscriptionCommunicatorUnsubscribeResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<JsonStringList> invalidSubscriptionIds)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      invalidSubscriptionIds_(std::move(invalidSubscriptionIds)) {
    AnswerTo(request, std::nullopt);
}

TagSubscriptionCommunicatorUnsubscribeResponse::TagSubscriptionCommunicatorUnsubscribeResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagSubscriptionCommunicatorUnsubscribeResponse::TagSubscriptionCommunicatorUnsubscribeResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorUnsubscribeResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
