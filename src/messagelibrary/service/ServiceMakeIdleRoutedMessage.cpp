#include "messagelibrary/service/ServiceMakeIdleRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

ServiceMakeIdleRoutedMessage::ServiceMakeIdleRoutedMessage(const std::string& target)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, target) {}

ServiceMakeIdleRoutedMessage::ServiceMakeIdleRoutedMessage(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody ServiceMakeIdleRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
