#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionsResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorGetSubscriptionsResponse::
    TagSubscriptionCommunicatorGetSubscriptionsResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<JsonStringList> subscriptionIds)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      subscriptionIds_(std::move(subscriptionIds)) {
    AnswerTo(request, std::nullopt);
}

TagSubscriptionCommunicatorGetSubscriptionsResponse::
    TagSubscriptionCommunicatorGetSubscriptionsResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagSubscriptionCommunicatorGetSubscriptionsResponse::
    TagSubscriptionCommunicatorGetSubscriptionsResponse(MessageBus::MessageHeaders headers,
                                                        const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorGetSubscriptionsResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
