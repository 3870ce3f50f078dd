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

// The work step to do, with its properties.
class WorkflowOfferToWorkResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "WorkflowOfferToWorkResponse";

    WorkflowOfferToWorkResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                std::optional<std::string> workflowName,
                                std::optional<std::string> jobId,
                                std::optional<std::string> workStepName,
                                std::optional<JsonStringMap> properties);
    // An error response: the fields stay unset.
    WorkflowOfferToWorkResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                const MessageBus::MessageError& error);
    // Parses a received body.
    WorkflowOfferToWorkResponse(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<std::string>& WorkflowName() const { return workflowName_; }
    const std::optional<std::string>& JobId() const { return jobId_; }
    const std::optional<std::string>& WorkStepName() const { return workStepName_; }
    const std::optional<JsonStringMap>& Properties() const { return properties_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("workflowName", self.workflowName_)
            .Field("jobId", self.jobId_)
            .Field("workStepName", self.workStepName_)
            .Field("properties", self.properties_);
    }

    std::optional<std::string> workflowName_;
    std::optional<std::string> jobId_;
    std::optional<std::string> workStepName_;
    std::optional<JsonStringMap> properties_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
