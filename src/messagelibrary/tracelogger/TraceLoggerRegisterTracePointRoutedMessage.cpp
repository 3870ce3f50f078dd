#include "messagelibrary/tracelogger/TraceLoggerRegisterTracePointRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerRegisterTracePointRoutedMessage::TraceLoggerRegisterTracePointRoutedMessage(
    std::optional<std::string> tracePointName)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService),
      tracePointName_(std::move(tracePointName)) {}

TraceLoggerRegisterTracePointRoutedMessage::TraceLoggerRegisterTracePointRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerRegisterTracePointRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
