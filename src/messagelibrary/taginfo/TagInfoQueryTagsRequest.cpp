#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoQueryTagsRequest::TagInfoQueryTagsRequest(std::optional<JsonStringList> searchPaths,
                                                 std::optional<JsonStringMap> properties,
                                                 std::optional<JsonStringList> keywords,
                                                 int32_t skip, int32_t take, bool allowStale)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      searchPaths_(std::move(searchPaths)),
      properties_(std::move(properties)),
      keywords_(std::move(keywords)),
      skip_(skip),
      take_(take),
      allowStale_(allowStale) {}

TagInfoQueryTagsRequest::TagInfoQueryTagsRequest(MessageBus::MessageHeaders headers,
                                                 const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json)
        .Field("searchPaths", searchPaths_)
        .Field("properties", properties_)
        .Field("keywords", keywords_)
        .Field("skip", skip_)
        .Field("take", take_)
        .Field("allowStale", allowStale_);
}

MessageBus::MessageBody TagInfoQueryTagsRequest::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter()
                                       .Field("searchPaths", searchPaths_)
                                       .Field("properties", properties_)
                                       .Field("keywords", keywords_)
                                       .Field("skip", skip_)
                                       .Field("take", take_)
                                       .Field("allowStale", allowStale_)
                                       .Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
