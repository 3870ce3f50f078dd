#include "messagelibrary/taghistorian/TagHistorianAsyncQueryDataRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncQueryDataRoutedMessage::TagHistorianAsyncQueryDataRoutedMessage(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<HistorianAsyncValues> tagHistorianAsyncValues)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      tagHistorianAsyncValues_(std::move(tagHistorianAsyncValues)) {}

TagHistorianAsyncQueryDataRoutedMessage::TagHistorianAsyncQueryDataRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncQueryDataRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
