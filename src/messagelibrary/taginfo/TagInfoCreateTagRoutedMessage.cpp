#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoCreateTagRoutedMessage::TagInfoCreateTagRoutedMessage(std::optional<TagRecord> newTag)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      newTag_(std::move(newTag)) {}

TagInfoCreateTagRoutedMessage::TagInfoCreateTagRoutedMessage(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoCreateTagRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
