#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorPushedUpdateRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

TagSubscriptionCommunicatorPushedUpdateRoutedMessage::
    TagSubscriptionCommunicatorPushedUpdateRoutedMessage(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::vector<SubscriptionUpdate>> updates)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      updates_(std::move(updates)) {}

TagSubscriptionCommunicatorPushedUpdateRoutedMessage::
    TagSubscriptionCommunicatorPushedUpdateRoutedMessage(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagSubscriptionCommunicatorPushedUpdateRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
