#include "messagelibrary/tagingestion/TagNewJournalsWrittenBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages {

TagNewJournalsWrittenBroadcast::TagNewJournalsWrittenBroadcast(
    std::optional<JsonStringList> journalIds)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      journalIds_(std::move(journalIds)) {}

TagNewJournalsWrittenBroadcast::TagNewJournalsWrittenBroadcast(MessageBus::MessageHeaders headers,
                                                               const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("journalIds", journalIds_);
}

MessageBus::MessageBody TagNewJournalsWrittenBroadcast::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("journalIds", journalIds_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagIngestionMessages
