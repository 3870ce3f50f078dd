#include "messagelibrary/tracelogger/TraceLoggerBroadcastTracePointsRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerBroadcastTracePointsRoutedMessage::TraceLoggerBroadcastTracePointsRoutedMessage()
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService) {}

TraceLoggerBroadcastTracePointsRoutedMessage::TraceLoggerBroadcastTracePointsRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerBroadcastTracePointsRoutedMessage::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
