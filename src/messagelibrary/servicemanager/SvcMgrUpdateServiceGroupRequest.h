#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/ServiceRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Replaces a group of a service.
class SvcMgrUpdateServiceGroupRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SvcMgrUpdateServiceGroupRequest";

    SvcMgrUpdateServiceGroupRequest(const std::string& target,
                                    std::optional<std::string> serviceName,
                                    std::optional<ServiceGroup> group);
    // Parses a received body.
    SvcMgrUpdateServiceGroupRequest(MessageBus::MessageHeaders headers,
                                    const MessageBus::MessageBody& body);

    const std::optional<std::string>& ServiceName() const { return serviceName_; }
    const std::optional<ServiceGroup>& Group() const { return group_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("serviceName", self.serviceName_).Field("group", self.group_);
    }

    std::optional<std::string> serviceName_;
    std::optional<ServiceGroup> group_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
