#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/workflow/WorkflowEnums.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

// Reports a finished work step and, with wantMoreWork, offers the node for the
// next one.
class WorkflowWorkCompleteRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "WorkflowWorkCompleteRequest";

    WorkflowWorkCompleteRequest(std::optional<std::string> workflowName,
                                std::optional<std::string> nodeName,
                                std::optional<std::string> jobId,
                                std::optional<std::string> workStepName,
                                std::optional<WorkflowWorkResult> workResult,
                                int32_t completionCode,
                                std::optional<JsonStringMap> outputProperties, bool wantMoreWork,
                                std::optional<JsonStringList> capabilities, int32_t timeoutSeconds);
    // Parses a received body.
    WorkflowWorkCompleteRequest(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<std::string>& WorkflowName() const { return workflowName_; }
    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<std::string>& JobId() const { return jobId_; }
    const std::optional<std::string>& WorkStepName() const { return workStepName_; }
    const std::optional<WorkflowWorkResult>& WorkResult() const { return workResult_; }
    int32_t CompletionCode() const { return completionCode_; }
    const std::optional<JsonStringMap>& OutputProperties() const { return outputProperties_; }
    bool WantMoreWork() const { return wantMoreWork_; }
    const std::optional<JsonStringList>& Capabilities() const { return capabilities_; }
    int32_t TimeoutSeconds() const { return timeoutSeconds_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("workflowName", self.workflowName_)
            .Field("nodeName", self.nodeName_)
            .Field("jobId", self.jobId_)
            .Field("workStepName", self.workStepName_)
            .Field("workResult", self.workResult_)
            .Field("completionCode", self.completionCode_)
            .Field("outputProperties", self.outputProperties_)
            .Field("wantMoreWork", self.wantMoreWork_)
            .Field("capabilities", self.capabilities_)
            .Field("timeoutSeconds", self.timeoutSeconds_);
    }

    std::optional<std::string> workflowName_;
    std::optional<std::string> nodeName_;
    std::optional<std::string> jobId_;
    std::optional<std::string> workStepName_;
    std::optional<WorkflowWorkResult> workResult_;
    int32_t completionCode_ = 0;
    std::optional<JsonStringMap> outputProperties_;
    bool wantMoreWork_ = false;
    std::optional<JsonStringList> capabilities_;
    int32_t timeoutSeconds_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
