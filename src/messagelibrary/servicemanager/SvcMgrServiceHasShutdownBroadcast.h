#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Tells that a service has shut down: its name and its queue.
class SvcMgrServiceHasShutdownBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrServiceHasShutdownBroadcast";

    SvcMgrServiceHasShutdownBroadcast(std::optional<std::string> service,
                                      std::optional<std::string> serviceReplyTo);
    // Parses a received body.
    SvcMgrServiceHasShutdownBroadcast(MessageBus::MessageHeaders headers,
                                      const MessageBus::MessageBody& body);

    const std::optional<std::string>& Service() const { return service_; }
    const std::optional<std::string>& ServiceReplyTo() const { return serviceReplyTo_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("service", self.service_).Field("serviceReplyTo", self.serviceReplyTo_);
    }

    std::optional<std::string> service_;
    std::optional<std::string> serviceReplyTo_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
