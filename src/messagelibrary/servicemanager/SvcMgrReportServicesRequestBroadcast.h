#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Asks every manager to report its services to the node named.
class SvcMgrReportServicesRequestBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrReportServicesRequestBroadcast";

    explicit SvcMgrReportServicesRequestBroadcast(std::optional<std::string> requestingNodeName);
    // Parses a received body.
    SvcMgrReportServicesRequestBroadcast(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    const std::optional<std::string>& RequestingNodeName() const { return requestingNodeName_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("requestingNodeName", self.requestingNodeName_);
    }

    std::optional<std::string> requestingNodeName_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
