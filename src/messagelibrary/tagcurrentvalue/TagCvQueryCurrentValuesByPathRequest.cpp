#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

TagCvQueryCurrentValuesByPathRequest::TagCvQueryCurrentValuesByPathRequest(
    std::optional<JsonStringList> paths, bool allowStale)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType,
                                 kTagCurrentValueService),
      paths_(std::move(paths)),
      allowStale_(allowStale) {}

TagCvQueryCurrentValuesByPathRequest::TagCvQueryCurrentValuesByPathRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagCvQueryCurrentValuesByPathRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
