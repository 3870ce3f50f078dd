#include "messagelibrary/taghttp/TagHttpGetSelectionRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpGetSelectionRequest::TagHttpGetSelectionRequest(std::optional<std::string> id)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHttpService),
      id_(std::move(id)) {}

TagHttpGetSelectionRequest::TagHttpGetSelectionRequest(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpGetSelectionRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
