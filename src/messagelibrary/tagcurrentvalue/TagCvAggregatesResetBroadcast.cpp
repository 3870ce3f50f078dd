#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

TagCvAggregatesResetBroadcast::TagCvAggregatesResetBroadcast(
    std::optional<std::vector<TagAggregatedUpdates>> updates)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      updates_(std::move(updates)) {}

TagCvAggregatesResetBroadcast::TagCvAggregatesResetBroadcast(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("updates", updates_);
}

MessageBus::MessageBody TagCvAggregatesResetBroadcast::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("updates", updates_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
