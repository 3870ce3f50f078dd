#include "messagelibrary/tracelogger/TraceLoggerTracePointListRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerTracePointListRequest::TraceLoggerTracePointListRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService) {}

TraceLoggerTracePointListRequest::TraceLoggerTracePointListRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    // No fields, but the body must still be JSON.
    ParseJsonBody(body.ToString(), MessageType());
}

MessageBus::MessageBody TraceLoggerTracePointListRequest::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
