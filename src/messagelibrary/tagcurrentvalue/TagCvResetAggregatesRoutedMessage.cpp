#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

TagCvResetAggregatesRoutedMessage::TagCvResetAggregatesRoutedMessage(
    std::optional<JsonStringList> paths)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType,
                                kTagCurrentValueService),
      paths_(std::move(paths)) {}

TagCvResetAggregatesRoutedMessage::TagCvResetAggregatesRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("paths", paths_);
}

MessageBus::MessageBody TagCvResetAggregatesRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("paths", paths_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
