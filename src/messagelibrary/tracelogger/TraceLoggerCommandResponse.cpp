#include "messagelibrary/tracelogger/TraceLoggerCommandResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerCommandResponse::TraceLoggerCommandResponse(
    const MessageBus::Interfaces::IRoutingSource& request,
    std::optional<JsonStringList> responseText)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      responseText_(std::move(responseText)) {
    AnswerTo(request, std::nullopt);
}

TraceLoggerCommandResponse::TraceLoggerCommandResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

TraceLoggerCommandResponse::TraceLoggerCommandResponse(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("responseText", responseText_);
}

MessageBus::MessageBody TraceLoggerCommandResponse::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("responseText", responseText_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
