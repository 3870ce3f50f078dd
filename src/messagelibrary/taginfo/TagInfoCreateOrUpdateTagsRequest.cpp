#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages {

TagInfoCreateOrUpdateTagsRequest::TagInfoCreateOrUpdateTagsRequest(
    std::optional<std::vector<TagChange>> tags, bool merge)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagInfoService),
      tags_(std::move(tags)),
      merge_(merge) {}

TagInfoCreateOrUpdateTagsRequest::TagInfoCreateOrUpdateTagsRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagInfoCreateOrUpdateTagsRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagInfoMessages
