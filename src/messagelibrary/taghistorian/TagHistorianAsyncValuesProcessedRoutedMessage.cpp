#include "messagelibrary/taghistorian/TagHistorianAsyncValuesProcessedRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncValuesProcessedRoutedMessage::TagHistorianAsyncValuesProcessedRoutedMessage(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<HistorianValue>> values)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      values_(std::move(values)) {}

TagHistorianAsyncValuesProcessedRoutedMessage::TagHistorianAsyncValuesProcessedRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncValuesProcessedRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
