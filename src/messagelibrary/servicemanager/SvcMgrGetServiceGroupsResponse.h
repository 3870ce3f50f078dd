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

// The groups of a service.
class SvcMgrGetServiceGroupsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SvcMgrGetServiceGroupsResponse";

    SvcMgrGetServiceGroupsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                   std::optional<std::vector<ServiceGroup>> groups);
    // An error response: the fields stay unset.
    SvcMgrGetServiceGroupsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                   const MessageBus::MessageError& error);
    // Parses a received body.
    SvcMgrGetServiceGroupsResponse(MessageBus::MessageHeaders headers,
                                   const MessageBus::MessageBody& body);

    const std::optional<std::vector<ServiceGroup>>& Groups() const { return groups_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("groups", self.groups_);
    }

    std::optional<std::vector<ServiceGroup>> groups_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
