#include "messagelibrary/workflow/WorkflowOfferToWorkRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/workflow/WorkflowService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

WorkflowOfferToWorkRequest::WorkflowOfferToWorkRequest(std::optional<std::string> workflowName,
                                                       std::optional<std::string> nodeName,
                                                       std::optional<JsonStringList> capabilities,
                                                       int32_t timeoutSeconds)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kWorkflowService),
      workflowName_(std::move(workflowName)),
      nodeName_(std::move(nodeName)),
      capabilities_(std::move(capabilities)),
      timeoutSeconds_(timeoutSeconds) {}

WorkflowOfferToWorkRequest::WorkflowOfferToWorkRequest(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody WorkflowOfferToWorkRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
