#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/TagServices.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

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
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("paths", paths_).Field("allowStale", allowStale_);
}

MessageBus::MessageBody TagCvQueryCurrentValuesByPathRequest::Serialize() const {
    return MessageBus::MessageBody(
        JsonBodyWriter().Field("paths", paths_).Field("allowStale", allowStale_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
