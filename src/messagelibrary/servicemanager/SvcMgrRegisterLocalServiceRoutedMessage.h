#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Registers a service with the manager of its node.
class SvcMgrRegisterLocalServiceRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "SvcMgrRegisterLocalServiceRoutedMessage";

    SvcMgrRegisterLocalServiceRoutedMessage(const std::string& target,
                                            std::optional<std::string> serviceGuid,
                                            std::optional<std::string> nodeName,
                                            std::optional<std::string> serviceName,
                                            std::optional<std::string> serviceGroupName,
                                            std::optional<std::string> replyToQueue,
                                            int32_t processId);
    // Parses a received body.
    SvcMgrRegisterLocalServiceRoutedMessage(MessageBus::MessageHeaders headers,
                                            const MessageBus::MessageBody& body);

    const std::optional<std::string>& ServiceGuid() const { return serviceGuid_; }
    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<std::string>& ServiceName() const { return serviceName_; }
    const std::optional<std::string>& ServiceGroupName() const { return serviceGroupName_; }
    const std::optional<std::string>& ReplyToQueue() const { return replyToQueue_; }
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
            .Field("replyToQueue", self.replyToQueue_)
            .Field("processId", self.processId_);
    }

    std::optional<std::string> serviceGuid_;
    std::optional<std::string> nodeName_;
    std::optional<std::string> serviceName_;
    std::optional<std::string> serviceGroupName_;
    std::optional<std::string> replyToQueue_;
    int32_t processId_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
