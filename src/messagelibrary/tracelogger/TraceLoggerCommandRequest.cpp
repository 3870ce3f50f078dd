#include "messagelibrary/tracelogger/TraceLoggerCommandRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerCommandRequest::TraceLoggerCommandRequest(std::optional<JsonStringList> arguments)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService),
      arguments_(std::move(arguments)) {}

TraceLoggerCommandRequest::TraceLoggerCommandRequest(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("arguments", arguments_);
}

MessageBus::MessageBody TraceLoggerCommandRequest::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("arguments", arguments_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
