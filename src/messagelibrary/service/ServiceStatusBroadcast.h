#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ServiceEnums.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

// A service's state, with where it runs and how to reach it.
class ServiceStatusBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "ServiceStatusBroadcast";

    ServiceStatusBroadcast(std::optional<std::string> nodeName,
                           std::optional<std::string> serviceGuid,
                           std::optional<std::string> serviceName,
                           std::optional<std::string> serviceGroupName,
                           std::optional<std::string> serviceReplyTo,
                           std::optional<VeldraMessageLibrary::ServiceState> serviceState);
    // Parses a received body.
    ServiceStatusBroadcast(MessageBus::MessageHeaders headers, const MessageBus::MessageBody& body);

    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<std::string>& ServiceGuid() const { return serviceGuid_; }
    const std::optional<std::string>& ServiceName() const { return serviceName_; }
    const std::optional<std::string>& ServiceGroupName() const { return serviceGroupName_; }
    const std::optional<std::string>& ServiceReplyTo() const { return serviceReplyTo_; }
    const std::optional<VeldraMessageLibrary::ServiceState>& ServiceState() const {
        return serviceState_;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("nodeName", self.nodeName_)
            .Field("serviceGuid", self.serviceGuid_)
            .Field("serviceName", self.serviceName_)
            .Field("serviceGroupName", self.serviceGroupName_)
            .Field("serviceReplyTo", self.serviceReplyTo_)
            .Field("serviceState", self.serviceState_);
    }

    std::optional<std::string> nodeName_;
    std::optional<std::string> serviceGuid_;
    std::optional<std::string> serviceName_;
    std::optional<std::string> serviceGroupName_;
    std::optional<std::string> serviceReplyTo_;
    std::optional<VeldraMessageLibrary::ServiceState> serviceState_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
