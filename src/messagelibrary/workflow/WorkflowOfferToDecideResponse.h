#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

// The job to decide on, at its current step.
class WorkflowOfferToDecideResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "WorkflowOfferToDecideResponse";

    WorkflowOfferToDecideResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                  std::optional<std::string> workflowName,
                                  std::optional<std::string> jobId,
                                  std::optional<JsonStringMap> jobProperties,
                                  std::optional<std::string> currentStepName);
    // An error response: the fields stay unset.
    WorkflowOfferToDecideResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                  const MessageBus::MessageError& error);
    // Parses a received body.
    WorkflowOfferToDecideResponse(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<std::string>& WorkflowName() const { return workflowName_; }
    const std::optional<std::string>& JobId() const { return jobId_; }
    const std::optional<JsonStringMap>& JobProperties() const { return jobProperties_; }
    const std::optional<std::string>& CurrentStepName() const { return currentStepName_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("workflowName", self.workflowName_)
            .Field("jobId", self.jobId_)
            .Field("jobProperties", self.jobProperties_)
            .Field("currentStepName", self.currentStepName_);
    }

    std::optional<std::string> workflowName_;
    std::optional<std::string> jobId_;
    std::optional<JsonStringMap> jobProperties_;
    std::optional<std::string> currentStepName_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
