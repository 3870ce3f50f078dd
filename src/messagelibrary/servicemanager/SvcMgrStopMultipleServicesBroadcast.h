#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Stops a service on a node, or kills it.
class SvcMgrStopMultipleServicesBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrStopMultipleServicesBroadcast";

    SvcMgrStopMultipleServicesBroadcast(std::optional<std::string> serviceName,
                                        std::optional<std::string> nodeName, bool kill);
    // Parses a received body.
    SvcMgrStopMultipleServicesBroadcast(MessageBus::MessageHeaders headers,
                                        const MessageBus::MessageBody& body);

    const std::optional<std::string>& ServiceName() const { return serviceName_; }
    const std::optional<std::string>& NodeName() const { return nodeName_; }
    bool Kill() const { return kill_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("serviceName", self.serviceName_)
            .Field("nodeName", self.nodeName_)
            .Field("kill", self.kill_);
    }

    std::optional<std::string> serviceName_;
    std::optional<std::string> nodeName_;
    bool kill_ = false;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
