#include "messagelibrary/taghistorian/TagHistorianValuesProcessedBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianValuesProcessedBroadcast::TagHistorianValuesProcessedBroadcast(
    std::optional<std::vector<HistorianValue>> values)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      values_(std::move(values)) {}

TagHistorianValuesProcessedBroadcast::TagHistorianValuesProcessedBroadcast(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianValuesProcessedBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
