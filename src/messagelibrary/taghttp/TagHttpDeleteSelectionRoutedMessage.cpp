#include "messagelibrary/taghttp/TagHttpDeleteSelectionRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpDeleteSelectionRoutedMessage::TagHttpDeleteSelectionRoutedMessage(
    std::optional<std::string> id)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagHttpService),
      id_(std::move(id)) {}

TagHttpDeleteSelectionRoutedMessage::TagHttpDeleteSelectionRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpDeleteSelectionRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
