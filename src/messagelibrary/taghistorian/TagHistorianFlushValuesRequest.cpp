#include "messagelibrary/taghistorian/TagHistorianFlushValuesRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianFlushValuesRequest::TagHistorianFlushValuesRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService) {
}

TagHistorianFlushValuesRequest::TagHistorianFlushValuesRequest(MessageBus::MessageHeaders headers,
                                                               const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianFlushValuesRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
