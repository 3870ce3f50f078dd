#include "messagelibrary/taghttp/TagHttpGetSelectionsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpGetSelectionsRequest::TagHttpGetSelectionsRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHttpService) {}

TagHttpGetSelectionsRequest::TagHttpGetSelectionsRequest(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpGetSelectionsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
