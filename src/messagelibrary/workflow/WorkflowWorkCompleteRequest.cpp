#include "messagelibrary/workflow/WorkflowWorkCompleteRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/workflow/WorkflowService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

WorkflowWorkCompleteRequest::WorkflowWorkCompleteRequest(
    std::optional<std::string> workflowName, std::optional<std::string> nodeName,
    std::optional<std::string> jobId, std::optional<std::string> workStepName,
    std::optional<WorkflowWorkResult> workResult, int32_t completionCode,
    std::optional<JsonStringMap> outputProperties, bool wantMoreWork,
    std::optional<JsonStringList> capabilities, int32_t timeoutSeconds)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kWorkflowService),
      workflowName_(std::move(workflowName)),
      nodeName_(std::move(nodeName)),
      jobId_(std::move(jobId)),
      workStepName_(std::move(workStepName)),
      workResult_(std::move(workResult)),
      completionCode_(completionCode),
      outputProperties_(std::move(outputProperties)),
      wantMoreWork_(wantMoreWork),
      capabilities_(std::move(capabilities)),
      timeoutSeconds_(timeoutSeconds) {}

WorkflowWorkCompleteRequest::WorkflowWorkCompleteRequest(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody WorkflowWorkCompleteRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
