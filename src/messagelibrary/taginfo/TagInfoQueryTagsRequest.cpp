#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

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
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoQueryTagsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
