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

// The services a manager knows.
class SvcMgrGetServiceInfoSnapshotResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SvcMgrGetServiceInfoSnapshotResponse";

    SvcMgrGetServiceInfoSnapshotResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                         std::optional<std::vector<ServiceInfo>> services);
    // An error response: the fields stay unset.
    SvcMgrGetServiceInfoSnapshotResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                         const MessageBus::MessageError& error);
    // Parses a received body.
    SvcMgrGetServiceInfoSnapshotResponse(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    const std::optional<std::vector<ServiceInfo>>& Services() const { return services_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("services", self.services_);
    }

    std::optional<std::vector<ServiceInfo>> services_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
