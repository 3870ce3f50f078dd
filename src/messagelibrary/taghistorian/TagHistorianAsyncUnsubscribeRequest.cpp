#include "messagelibrary/taghistorian/TagHistorianAsyncUnsubscribeRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncUnsubscribeRequest::TagHistorianAsyncUnsubscribeRequest(
    std::optional<JsonStringList> searchPaths)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService),
      searchPaths_(std::move(searchPaths)) {}

TagHistorianAsyncUnsubscribeRequest::TagHistorianAsyncUnsubscribeRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncUnsubscribeRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
