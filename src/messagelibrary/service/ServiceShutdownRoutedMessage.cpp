#include "messagelibrary/service/ServiceShutdownRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

ServiceShutdownRoutedMessage::ServiceShutdownRoutedMessage(const std::string& target)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, target) {}

ServiceShutdownRoutedMessage::ServiceShutdownRoutedMessage(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ServiceShutdownRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
