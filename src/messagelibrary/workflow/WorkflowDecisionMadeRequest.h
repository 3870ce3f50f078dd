#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/workflow/WorkflowEnums.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

// Tells the decision made for a job: its new status and the next step.
class WorkflowDecisionMadeRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "WorkflowDecisionMadeRequest";

    WorkflowDecisionMadeRequest(std::optional<std::string> workflowName,
                                std::optional<std::string> nodeName,
                                std::optional<std::string> jobId,
                                std::optional<WorkflowJobStatus> jobStatus,
                                std::optional<JsonStringMap> jobProperties,
                                std::optional<std::string> nextStepName);
    // Parses a received body.
    WorkflowDecisionMadeRequest(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<std::string>& WorkflowName() const { return workflowName_; }
    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<std::string>& JobId() const { return jobId_; }
    const std::optional<WorkflowJobStatus>& JobStatus() const { return jobStatus_; }
    const std::optional<JsonStringMap>& JobProperties() const { return jobProperties_; }
    const std::optional<std::string>& NextStepName() const { return nextStepName_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("workflowName", self.workflowName_)
            .Field("nodeName", self.nodeName_)
            .Field("jobId", self.jobId_)
            .Field("jobStatus", self.jobStatus_)
            .Field("jobProperties", self.jobProperties_)
            .Field("nextStepName", self.nextStepName_);
    }

    std::optional<std::string> workflowName_;
    std::optional<std::string> nodeName_;
    std::optional<std::string> jobId_;
    std::optional<WorkflowJobStatus> jobStatus_;
    std::optional<JsonStringMap> jobProperties_;
    std::optional<std::string> nextStepName_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
