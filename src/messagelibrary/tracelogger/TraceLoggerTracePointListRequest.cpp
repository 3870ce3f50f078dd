#include "messagelibrary/tracelogger/TraceLoggerTracePointListRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerTracePointListRequest::TraceLoggerTracePointListRequest()
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService) {}

TraceLoggerTracePointListRequest::TraceLoggerTracePointListRequest(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerTracePointListRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
