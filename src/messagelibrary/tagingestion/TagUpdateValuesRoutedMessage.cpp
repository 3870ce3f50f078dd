#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

TagUpdateValuesRoutedMessage::TagUpdateValuesRoutedMessage(
    std::optional<std::vector<TagPathUpdates>> updates)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagIngestionService),
      updates_(std::move(updates)) {}

TagUpdateValuesRoutedMessage::TagUpdateValuesRoutedMessage(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagUpdateValuesRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
