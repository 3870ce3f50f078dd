#include "messagelibrary/workflow/WorkflowOfferToDecideResponse.h"

#include <optional>
#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

WorkflowOfferToDecideResponse::WorkflowOfferToDecideResponse(
    const MessageBus::Interfaces::IRoutingSource& request, std::optional<std::string> workflowName,
    std::optional<std::string> jobId, std::optional<JsonStringMap> jobProperties,
    std::optional<std::string> currentStepName)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()),
      workflowName_(std::move(workflowName)),
      jobId_(std::move(jobId)),
      jobProperties_(std::move(jobProperties)),
      currentStepName_(std::move(currentStepName)) {
    AnswerTo(request, std::nullopt);
}

WorkflowOfferToDecideResponse::WorkflowOfferToDecideResponse(
    const MessageBus::Interfaces::IRoutingSource& request, const MessageBus::MessageError& error)
    : MessageBus::ResponseMessage(kMessageName, MessageBus::kJsonContentType, request.ReplyTo()) {
    AnswerTo(request, error);
}

WorkflowOfferToDecideResponse::WorkflowOfferToDecideResponse(MessageBus::MessageHeaders headers,
                                                             const MessageBus::MessageBody& body)
    : MessageBus::ResponseMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody WorkflowOfferToDecideResponse::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
