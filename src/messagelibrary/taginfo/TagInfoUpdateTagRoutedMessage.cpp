#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoUpdateTagRoutedMessage::TagInfoUpdateTagRoutedMessage(
    std::optional<std::string> path, std::optional<JsonStringList> keywords,
    std::optional<JsonStringMap> properties,
    std::optional<CollectAggregatesChange> collectAggregates, bool replace)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      path_(std::move(path)),
      keywords_(std::move(keywords)),
      properties_(std::move(properties)),
      collectAggregates_(std::move(collectAggregates)),
      replace_(replace) {}

TagInfoUpdateTagRoutedMessage::TagInfoUpdateTagRoutedMessage(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoUpdateTagRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
