#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoDeletedTagsBroadcast::TagInfoDeletedTagsBroadcast(std::optional<JsonStringList> tags)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      tags_(std::move(tags)) {}

TagInfoDeletedTagsBroadcast::TagInfoDeletedTagsBroadcast(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoDeletedTagsBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
