#include "messagelibrary/tracelogger/TraceLoggerTracePointListResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerTracePointListResponse::TraceLoggerTracePointListResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<std::vector<TracePointSetting>> settings)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      settings_(std::move(settings)) {
    AnswerTo(request, std::nullopt);
}

TraceLoggerTracePointListResponse::TraceLoggerTracePointListResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TraceLoggerTracePointListResponse::TraceLoggerTracePointListResponse(
    MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerTracePointListResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
