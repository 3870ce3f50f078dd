#include "messagelibrary/workflow/WorkflowDecisionMadeRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/workflow/WorkflowService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

WorkflowDecisionMadeRequest::WorkflowDecisionMadeRequest(std::optional<std::string> workflowName,
                                                         std::optional<std::string> nodeName,
                                                         std::optional<std::string> jobId,
                                                         std::optional<WorkflowJobStatus> jobStatus,
                                                         std::optional<JsonStringMap> jobProperties,
                                                         std::optional<std::string> nextStepName)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kWorkflowService),
      workflowName_(std::move(workflowName)),
      nodeName_(std::move(nodeName)),
      jobId_(std::move(jobId)),
      jobStatus_(std::move(jobStatus)),
      jobProperties_(std::move(jobProperties)),
      nextStepName_(std::move(nextStepName)) {}

WorkflowDecisionMadeRequest::WorkflowDecisionMadeRequest(MessageBus::MessageHeaders headers,
                                                         const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody WorkflowDecisionMadeRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
