#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Asks for the groups of a service.
class SvcMgrGetServiceGroupsRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SvcMgrGetServiceGroupsRequest";

    SvcMgrGetServiceGroupsRequest(const std::string& target,
                                  std::optional<std::string> serviceName);
    // Parses a received body.
    SvcMgrGetServiceGroupsRequest(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<std::string>& ServiceName() const { return serviceName_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("serviceName", self.serviceName_);
    }

    std::optional<std::string> serviceName_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
