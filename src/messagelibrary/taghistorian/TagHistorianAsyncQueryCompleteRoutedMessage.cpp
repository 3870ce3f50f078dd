#include "messagelibrary/taghistorian/TagHistorianAsyncQueryCompleteRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

TagHistorianAsyncQueryCompleteRoutedMessage::TagHistorianAsyncQueryCompleteRoutedMessage(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<HistorianQueryJob>> queryJobs)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      queryJobs_(std::move(queryJobs)) {}

TagHistorianAsyncQueryCompleteRoutedMessage::TagHistorianAsyncQueryCompleteRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TagHistorianAsyncQueryCompleteRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
