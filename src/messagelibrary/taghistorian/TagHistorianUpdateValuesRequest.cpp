#include "messagelibrary/taghistorian/TagHistorianUpdateValuesRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/TagServices.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianUpdateValuesRequest::TagHistorianUpdateValuesRequest(
    std::optional<std::string> path, std::optional<std::vector<HistorianValueUpdate>> values)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTagHistorianService),
      path_(std::move(path)),
      values_(std::move(values)) {}

TagHistorianUpdateValuesRequest::TagHistorianUpdateValuesRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianUpdateValuesRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
