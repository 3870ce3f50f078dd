#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoDeleteTagsRoutedMessage::TagInfoDeleteTagsRoutedMessage(std::optional<JsonStringList> paths)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      paths_(std::move(paths)) {}

TagInfoDeleteTagsRoutedMessage::TagInfoDeleteTagsRoutedMessage(MessageBus::MessageHeaders headers,
                                                               const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoDeleteTagsRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
