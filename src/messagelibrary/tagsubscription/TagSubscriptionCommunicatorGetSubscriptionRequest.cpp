#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorGetSubscriptionRequest::
    TagSubscriptionCommunicatorGetSubscriptionRequest(std::optional<std::string> subscriptionId)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService),
      subscriptionId_(std::move(subscriptionId)) {}

TagSubscriptionCommunicatorGetSubscriptionRequest::
    TagSubscriptionCommunicatorGetSubscriptionRequest(MessageBus::MessageHeaders headers,
                                                      const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorGetSubscriptionRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
