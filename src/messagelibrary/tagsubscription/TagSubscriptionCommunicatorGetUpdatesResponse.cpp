#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorGetUpdatesResponse::TagSubscriptionCommunicatorGetUpdatesResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<SubscriptionUpdate>> updates,
    std::optional<JsonStringList> invalidSubscriptionIds)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      updates_(std::move(updates)),
      invalidSubscriptionIds_(std::move(invalidSubscriptionIds)) {
    AnswerTo(request, std::nullopt);
}

TagSubscriptionCommunicatorGetUpdatesResponse::TagSubscriptionCommunicatorGetUpdatesResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TagSubscriptionCommunicatorGetUpdatesResponse::TagSubscriptionCommunicatorGetUpdatesResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorGetUpdatesResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
