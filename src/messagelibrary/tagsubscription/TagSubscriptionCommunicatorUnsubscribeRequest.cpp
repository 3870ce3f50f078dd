#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorUnsubscribeRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorUnsubscribeRequest::TagSubscriptionCommunicatorUnsubscribeRequest(
    std::optional<JsonStringList> subscriptionIds)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService),
      subscriptionIds_(std::move(subscriptionIds)) {}

TagSubscriptionCommunicatorUnsubscribeRequest::TagSubscriptionCommunicatorUnsubscribeRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorUnsubscribeRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
