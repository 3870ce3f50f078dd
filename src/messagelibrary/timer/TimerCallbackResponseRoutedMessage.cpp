#include "messagelibrary/timer/TimerCallbackResponseRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/timer/TimerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

TimerCallbackResponseRoutedMessage::TimerCallbackResponseRoutedMessage(
    std::optional<std::string> token)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTimerService),
      token_(std::move(token)) {}

TimerCallbackResponseRoutedMessage::TimerCallbackResponseRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TimerCallbackResponseRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
