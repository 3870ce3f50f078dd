#include "messagelibrary/service/ServiceGoLiveRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

ServiceGoLiveRoutedMessage::ServiceGoLiveRoutedMessage(const std::string& target,
                                                       std::optional<std::string> serviceGuid)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, target),
      serviceGuid_(std::move(serviceGuid)) {}

ServiceGoLiveRoutedMessage::ServiceGoLiveRoutedMessage(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ServiceGoLiveRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
