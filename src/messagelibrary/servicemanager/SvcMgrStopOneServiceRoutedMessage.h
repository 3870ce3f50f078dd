#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Stops one instance of a service, or kills it.
class SvcMgrStopOneServiceRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "SvcMgrStopOneServiceRoutedMessage";

    SvcMgrStopOneServiceRoutedMessage(const std::string& target, int32_t processId,
                                      std::optional<std::string> serviceGuid, bool kill);
    // Parses a received body.
    SvcMgrStopOneServiceRoutedMessage(MessageBus::MessageHeaders headers,
                                      const MessageBus::MessageBody& body);

    int32_t ProcessId() const { return processId_; }
    const std::optional<std::string>& ServiceGuid() const { return serviceGuid_; }
    bool Kill() const { return kill_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("processId", self.processId_)
            .Field("serviceGuid", self.serviceGuid_)
            .Field("kill", self.kill_);
    }

    int32_t processId_ = 0;
    std::optional<std::string> serviceGuid_;
    bool kill_ = false;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
