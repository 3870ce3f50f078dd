#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ServiceRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// A manager's report of its services.
class SvcMgrReportServicesResponseBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrReportServicesResponseBroadcast";

    SvcMgrReportServicesResponseBroadcast(std::optional<std::string> nodeName,
                                          std::optional<std::vector<ServiceInfo>> services);
    // Parses a received body.
    SvcMgrReportServicesResponseBroadcast(MessageBus::MessageHeaders headers,
                                          const MessageBus::MessageBody& body);

    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<std::vector<ServiceInfo>>& Services() const { return services_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("nodeName", self.nodeName_).Field("services", self.services_);
    }

    std::optional<std::string> nodeName_;
    std::optional<std::vector<ServiceInfo>> services_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
