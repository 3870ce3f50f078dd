#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages {

// Offers a node to decide on a job of a workflow, waiting up to timeoutSeconds.
class WorkflowOfferToDecideRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "WorkflowOfferToDecideRequest";

    WorkflowOfferToDecideRequest(std::optional<std::string> workflowName,
                                 std::optional<std::string> nodeName, int32_t timeoutSeconds);
    // Parses a received body.
    WorkflowOfferToDecideRequest(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::string>& WorkflowName() const { return workflowName_; }
    const std::optional<std::string>& NodeName() const { return nodeName_; }
    int32_t TimeoutSeconds() const { return timeoutSeconds_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("workflowName", self.workflowName_)
            .Field("nodeName", self.nodeName_)
            .Field("timeoutSeconds", self.timeoutSeconds_);
    }

    std::optional<std::string> workflowName_;
    std::optional<std::string> nodeName_;
    int32_t timeoutSeconds_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::WorkflowMessages
