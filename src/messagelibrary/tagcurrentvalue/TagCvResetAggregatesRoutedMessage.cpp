#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

TagCvResetAggregatesRoutedMessage::TagCvResetAggregatesRoutedMessage(
    std::optional<JsonStringList> paths)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType,
                                kTagCurrentValueService),
      paths_(std::move(paths)) {}

TagCvResetAggregatesRoutedMessage::TagCvResetAggregatesRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagCvResetAggregatesRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
