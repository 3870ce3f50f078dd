#include "messagelibrary/tracelogger/TraceLoggerRegisterTracePointRoutedMessage.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerRegisterTracePointRoutedMessage::TraceLoggerRegisterTracePointRoutedMessage(
    std::optional<std::string> tracePointName)
    : MessageBus::RoutedMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService),
      tracePointName_(std::move(tracePointName)) {}

TraceLoggerRegisterTracePointRoutedMessage::TraceLoggerRegisterTracePointRoutedMessage(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RoutedMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("tracePointName", tracePointName_);
}

MessageBus::MessageBody TraceLoggerRegisterTracePointRoutedMessage::Serialize() const {
    return MessageBus::MessageBody(
        JsonBodyWriter().Field("tracePointName", tracePointName_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
