#include "messagelibrary/tracelogger/TraceLoggerBroadcastTracePointsRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerBroadcastTracePointsRoutedMessage::TraceLoggerBroadcastTracePointsRoutedMessage()
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService) {}

TraceLoggerBroadcastTracePointsRoutedMessage::TraceLoggerBroadcastTracePointsRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    // No fields, but the body must still be JSON.
    ParseJsonBody(body.ToString(), MessageType());
}

MessageBus::MessageBody TraceLoggerBroadcastTracePointsRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
