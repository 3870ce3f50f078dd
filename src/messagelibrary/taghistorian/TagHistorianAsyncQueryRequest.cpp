#include "messagelibrary/taghistorian/TagHistorianAsyncQueryRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncQueryRequest::TagHistorianAsyncQueryRequest(
    std::optional<std::vector<HistorianQuery>> queries)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService),
      queries_(std::move(queries)) {}

TagHistorianAsyncQueryRequest::TagHistorianAsyncQueryRequest(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncQueryRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
