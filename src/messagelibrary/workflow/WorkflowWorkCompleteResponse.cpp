#include "messagelibrary/workflow/WorkflowWorkCompleteResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

WorkflowWorkCompleteResponse::WorkflowWorkCompleteResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<std::string> workflowName,
    std::optional<std::string> jobId, std::optional<std::string> workStepName,
    std::optional<JsonStringMap> properties)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      workflowName_(std::move(workflowName)),
      jobId_(std::move(jobId)),
      workStepName_(std::move(workStepName)),
      properties_(std::move(properties)) {
    AnswerTo(request, std::nullopt);
}

WorkflowWorkCompleteResponse::WorkflowWorkCompleteResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

WorkflowWorkCompleteResponse::WorkflowWorkCompleteResponse(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody WorkflowWorkCompleteResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
