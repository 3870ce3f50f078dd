#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorGetSubscriptionsRequest::
    TagSubscriptionCommunicatorGetSubscriptionsRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService) {}

TagSubscriptionCommunicatorGetSubscriptionsRequest::
    TagSubscriptionCommunicatorGetSubscriptionsRequest(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorGetSubscriptionsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
