#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/ServiceRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// The managers that run, by node.
class SvcMgrRunningServiceManagersResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SvcMgrRunningServiceManagersResponse";

    SvcMgrRunningServiceManagersResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                         std::optional<std::vector<ServiceManagerNode>> nodes);
    // An error response: the fields stay unset.
    SvcMgrRunningServiceManagersResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                         const MessageBus::MessageError& error);
    // Parses a received body.
    SvcMgrRunningServiceManagersResponse(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    const std::optional<std::vector<ServiceManagerNode>>& Nodes() const { return nodes_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("nodes", self.nodes_);
    }

    std::optional<std::vector<ServiceManagerNode>> nodes_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
