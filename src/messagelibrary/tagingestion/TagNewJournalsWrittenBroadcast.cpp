#include "messagelibrary/tagingestion/TagNewJournalsWrittenBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

TagNewJournalsWrittenBroadcast::TagNewJournalsWrittenBroadcast(
    std::optional<JsonStringList> journalIds)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      journalIds_(std::move(journalIds)) {}

TagNewJournalsWrittenBroadcast::TagNewJournalsWrittenBroadcast(MessageBus::MessageHeaders headers,
                                                               const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagNewJournalsWrittenBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
