#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

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
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json)
        .Field("path", path_)
        .Field("keywords", keywords_)
        .Field("properties", properties_)
        .Field("collectAggregates", collectAggregates_)
        .Field("replace", replace_);
}

MessageBus::MessageBody TagInfoUpdateTagRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter()
                                       .Field("path", path_)
                                       .Field("keywords", keywords_)
                                       .Field("properties", properties_)
                                       .Field("collectAggregates", collectAggregates_)
                                       .Field("replace", replace_)
                                       .Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
