#include "messagelibrary/tracelogger/TraceLoggerTracePointListResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

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
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("settings", settings_);
}

MessageBus::MessageBody TraceLoggerTracePointListResponse::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("settings", settings_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
