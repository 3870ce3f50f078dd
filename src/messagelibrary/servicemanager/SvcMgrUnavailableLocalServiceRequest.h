#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Tells the manager of its node that a service is no longer available.
class SvcMgrUnavailableLocalServiceRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SvcMgrUnavailableLocalServiceRequest";

    SvcMgrUnavailableLocalServiceRequest(const std::string& target,
                                         std::optional<std::string> serviceGuid,
                                         std::optional<std::string> nodeName,
                                         std::optional<std::string> serviceName,
                                         std::optional<std::string> serviceGroupName,
                                         int32_t processId);
    // Parses a received body.
    SvcMgrUnavailableLocalServiceRequest(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    const std::optional<std::string>& ServiceGuid() const { return serviceGuid_; }
    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<std::string>& ServiceName() const { return serviceName_; }
    const std::optional<std::string>& ServiceGroupName() const { return serviceGroupName_; }
    int32_t ProcessId() const { return processId_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("serviceGuid", self.serviceGuid_)
            .Field("nodeName", self.nodeName_)
            .Field("serviceName", self.serviceName_)
            .Field("serviceGroupName", self.serviceGroupName_)
            .Field("processId", self.processId_);
    }

    std::optional<std::string> serviceGuid_;
    std::optional<std::string> nodeName_;
    std::optional<std::string> serviceName_;
    std::optional<std::string> serviceGroupName_;
    int32_t processId_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
