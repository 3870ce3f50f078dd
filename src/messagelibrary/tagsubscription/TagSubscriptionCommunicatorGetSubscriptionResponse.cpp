#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorGetSubscriptionResponse::
    TagSubscriptionCommunicatorGetSubscriptionResponse(
        const MessageBus::Interfaces::IRoutingSource& request, bool validSubscription,
        std::optional<std::string> alias, std::optional<SubscriptionOptions> options,
        std::optional<JsonStringList> tags)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      validSubscription_(validSubscription),
      alias_(std::move(alias)),
      options_(std::move(options)),
      tags_(std::move(tags)) {
    AnswerTo(request, std::nullopt);
}

TagSubscriptionCommunicatorGetSubscriptionResponse::
    TagSubscriptionCommunicatorGetSubscriptionResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagSubscriptionCommunicatorGetSubscriptionResponse::
    TagSubscriptionCommunicatorGetSubscriptionResponse(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorGetSubscriptionResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
