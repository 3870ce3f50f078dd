#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

TagNewTagsIngestedBroadcast::TagNewTagsIngestedBroadcast(
    std::optional<std::vector<TagUpdateSet>> updates)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      updates_(std::move(updates)) {}

TagNewTagsIngestedBroadcast::TagNewTagsIngestedBroadcast(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagNewTagsIngestedBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
