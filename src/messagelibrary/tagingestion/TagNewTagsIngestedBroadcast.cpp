#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

TagNewTagsIngestedBroadcast::TagNewTagsIngestedBroadcast(
    std::optional<std::vector<TagUpdateSet>> updates)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      updates_(std::move(updates)) {}

TagNewTagsIngestedBroadcast::TagNewTagsIngestedBroadcast(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("updates", updates_);
}

MessageBus::MessageBody TagNewTagsIngestedBroadcast::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("updates", updates_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
