#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoCreateTagRoutedMessage::TagInfoCreateTagRoutedMessage(std::optional<TagRecord> newTag)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      newTag_(std::move(newTag)) {}

TagInfoCreateTagRoutedMessage::TagInfoCreateTagRoutedMessage(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("newTag", newTag_);
}

MessageBus::MessageBody TagInfoCreateTagRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("newTag", newTag_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
