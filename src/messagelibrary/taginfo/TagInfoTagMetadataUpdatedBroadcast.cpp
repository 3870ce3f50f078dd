#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoTagMetadataUpdatedBroadcast::TagInfoTagMetadataUpdatedBroadcast(
    std::optional<TagRecord> updatedTag)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      updatedTag_(std::move(updatedTag)) {}

TagInfoTagMetadataUpdatedBroadcast::TagInfoTagMetadataUpdatedBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoTagMetadataUpdatedBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
