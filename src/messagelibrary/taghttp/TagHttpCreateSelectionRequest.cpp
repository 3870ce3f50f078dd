#include "messagelibrary/taghttp/TagHttpCreateSelectionRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

TagHttpCreateSelectionRequest::TagHttpCreateSelectionRequest(std::optional<TagSelection> selection)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHttpService),
      selection_(std::move(selection)) {}

TagHttpCreateSelectionRequest::TagHttpCreateSelectionRequest(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHttpCreateSelectionRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
