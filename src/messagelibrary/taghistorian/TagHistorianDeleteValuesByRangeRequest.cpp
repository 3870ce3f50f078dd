#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByRangeRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianDeleteValuesByRangeRequest::TagHistorianDeleteValuesByRangeRequest(
    std::optional<std::vector<HistorianDeleteRange>> ranges)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService),
      ranges_(std::move(ranges)) {}

TagHistorianDeleteValuesByRangeRequest::TagHistorianDeleteValuesByRangeRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianDeleteValuesByRangeRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
