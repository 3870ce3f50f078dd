#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscribeResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorSubscribeResponse::TagSubscriptionCommunicatorSubscribeResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::string> subscriptionId, std::optional<std::string> alias,
    std::optional<JsonStringList> nonexistentTags)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      subscriptionId_(std::move(subscriptionId)),
      alias_(std::move(alias)),
      nonexistentTags_(std::move(nonexistentTags)) {
    AnswerTo(request, std::nullopt);
}

TagSubscriptionCommunicatorSubscribeResponse::TagSubscriptionCommunicatorSubscribeResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagSubscriptionCommunicatorSubscribeResponse::TagSubscriptionCommunicatorSubscribeResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorSubscribeResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
