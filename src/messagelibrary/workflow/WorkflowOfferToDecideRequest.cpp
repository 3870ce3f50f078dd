#include "messagelibrary/workflow/WorkflowOfferToDecideRequest.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/workflow/WorkflowService.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

WorkflowOfferToDecideRequest::WorkflowOfferToDecideRequest(std::optional<std::string> workflowName,
                                                           std::optional<std::string> nodeName,
                                                           int32_t timeoutSeconds)
    : MessageBus::RequestMessage(kMessageName, MessageBus::kJsonContentType, kWorkflowService),
      workflowName_(std::move(workflowName)),
      nodeName_(std::move(nodeName)),
      timeoutSeconds_(timeoutSeconds) {}

WorkflowOfferToDecideRequest::WorkflowOfferToDecideRequest(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::RequestMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody WorkflowOfferToDecideRequest::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
