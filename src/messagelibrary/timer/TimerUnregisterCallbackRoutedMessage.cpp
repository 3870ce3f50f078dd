#include "messagelibrary/timer/TimerUnregisterCallbackRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/timer/TimerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

TimerUnregisterCallbackRoutedMessage::TimerUnregisterCallbackRoutedMessage(
    std::optional<std::string> token)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTimerService),
      token_(std::move(token)) {}

TimerUnregisterCallbackRoutedMessage::TimerUnregisterCallbackRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TimerUnregisterCallbackRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
