#include "messagelibrary/tracelogger/TraceLoggerCommandRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/tracelogger/TraceLoggerService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerCommandRequest::TraceLoggerCommandRequest(std::optional<JsonStringList> arguments)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kTraceLoggerService),
      arguments_(std::move(arguments)) {}

TraceLoggerCommandRequest::TraceLoggerCommandRequest(MessageBus::MessageHeaders headers,
                                                     const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerCommandRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
