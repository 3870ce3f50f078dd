#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

TagUpdateValuesRoutedMessage::TagUpdateValuesRoutedMessage(
    std::optional<std::vector<TagPathUpdates>> updates)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagIngestionService),
      updates_(std::move(updates)) {}

TagUpdateValuesRoutedMessage::TagUpdateValuesRoutedMessage(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("updates", updates_);
}

MessageBus::MessageBody TagUpdateValuesRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("updates", updates_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
