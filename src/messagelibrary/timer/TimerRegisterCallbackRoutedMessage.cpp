#include "messagelibrary/timer/TimerRegisterCallbackRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/timer/TimerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

TimerRegisterCallbackRoutedMessage::TimerRegisterCallbackRoutedMessage(
    std::optional<TimerCallbackType> callbackType, double elapsedMinutes,
    std::optional<std::string> token)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTimerService),
      callbackType_(std::move(callbackType)),
      elapsedMinutes_(elapsedMinutes),
      token_(std::move(token)) {}

TimerRegisterCallbackRoutedMessage::TimerRegisterCallbackRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TimerRegisterCallbackRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
