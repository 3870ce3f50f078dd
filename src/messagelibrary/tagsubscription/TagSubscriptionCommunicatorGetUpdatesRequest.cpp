#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorGetUpdatesRequest::TagSubscriptionCommunicatorGetUpdatesRequest(
    std::optional<JsonStringList> subscriptionIds)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService),
      subscriptionIds_(std::move(subscriptionIds)) {}

TagSubscriptionCommunicatorGetUpdatesRequest::TagSubscriptionCommunicatorGetUpdatesRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorGetUpdatesRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
