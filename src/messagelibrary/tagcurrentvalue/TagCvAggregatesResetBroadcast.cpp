#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

TagCvAggregatesResetBroadcast::TagCvAggregatesResetBroadcast(
    std::optional<std::vector<TagAggregatedUpdates>> updates)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      updates_(std::move(updates)) {}

TagCvAggregatesResetBroadcast::TagCvAggregatesResetBroadcast(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagCvAggregatesResetBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
