#include "messagelibrary/taghttp/TagHttpUpdateSelectionRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpUpdateSelectionRoutedMessage::TagHttpUpdateSelectionRoutedMessage(
    std::optional<TagSelection> selection)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagHttpService),
      selection_(std::move(selection)) {}

TagHttpUpdateSelectionRoutedMessage::TagHttpUpdateSelectionRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpUpdateSelectionRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
