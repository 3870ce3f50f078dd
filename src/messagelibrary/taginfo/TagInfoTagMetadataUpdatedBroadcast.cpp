#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoTagMetadataUpdatedBroadcast::TagInfoTagMetadataUpdatedBroadcast(
    std::optional<TagRecord> updatedTag)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      updatedTag_(std::move(updatedTag)) {}

TagInfoTagMetadataUpdatedBroadcast::TagInfoTagMetadataUpdatedBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("updatedTag", updatedTag_);
}

MessageBus::MessageBody TagInfoTagMetadataUpdatedBroadcast::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("updatedTag", updatedTag_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
