#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoDeletedTagsBroadcast::TagInfoDeletedTagsBroadcast(std::optional<JsonStringList> tags)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      tags_(std::move(tags)) {}

TagInfoDeletedTagsBroadcast::TagInfoDeletedTagsBroadcast(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("tags", tags_);
}

MessageBus::MessageBody TagInfoDeletedTagsBroadcast::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("tags", tags_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
