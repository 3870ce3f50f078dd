#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscriptionHeartbeatRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorSubscriptionHeartbeatRequest::
    TagSubscriptionCommunicatorSubscriptionHeartbeatRequest(
        std::optional<JsonStringList> subscriptionIds)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService),
      subscriptionIds_(std::move(subscriptionIds)) {}

TagSubscriptionCommunicatorSubscriptionHeartbeatRequest::
    TagSubscriptionCommunicatorSubscriptionHeartbeatRequest(MessageBus::MessageHeaders headers,
                                                            const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorSubscriptionHeartbeatRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
