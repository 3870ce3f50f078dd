#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByIdRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianDeleteValuesByIdRequest::TagHistorianDeleteValuesByIdRequest(
    std::optional<std::string> path, std::optional<JsonStringList> ids)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService),
      path_(std::move(path)),
      ids_(std::move(ids)) {}

TagHistorianDeleteValuesByIdRequest::TagHistorianDeleteValuesByIdRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianDeleteValuesByIdRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
