#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscribeRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorSubscribeRequest::TagSubscriptionCommunicatorSubscribeRequest(
    std::optional<std::string> alias, std::optional<SubscriptionOptions> options,
    std::optional<JsonStringList> tags)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagSubscriptionCommunicatorService),
      alias_(std::move(alias)),
      options_(std::move(options)),
      tags_(std::move(tags)) {}

TagSubscriptionCommunicatorSubscribeRequest::TagSubscriptionCommunicatorSubscribeRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorSubscribeRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
