#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// A manager's sign of life, by node.
class SvcMgrHeartbeatBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrHeartbeatBroadcast";

    explicit SvcMgrHeartbeatBroadcast(std::optional<std::string> nodeName);
    // Parses a received body.
    SvcMgrHeartbeatBroadcast(MessageBus::MessageHeaders headers,
                             const MessageBus::MessageBody& body);

    const std::optional<std::string>& NodeName() const { return nodeName_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("nodeName", self.nodeName_);
    }

    std::optional<std::string> nodeName_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
