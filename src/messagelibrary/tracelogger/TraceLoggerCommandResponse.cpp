#include "messagelibrary/tracelogger/TraceLoggerCommandResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

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
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerCommandResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
