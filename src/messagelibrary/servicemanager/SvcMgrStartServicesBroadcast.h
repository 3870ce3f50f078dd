#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Starts instances of services on nodes. allNodes and allServices, each
// written before its list, stand for every node or every service.
class SvcMgrStartServicesBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrStartServicesBroadcast";

    SvcMgrStartServicesBroadcast(bool allNodes, std::optional<JsonStringList> nodeNames,
                                 bool allServices, std::optional<JsonStringList> serviceNames,
                                 int32_t instanceCount);
    // Parses a received body.
    SvcMgrStartServicesBroadcast(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    bool AllNodes() const { return allNodes_; }
    const std::optional<JsonStringList>& NodeNames() const { return nodeNames_; }
    bool AllServices() const { return allServices_; }
    const std::optional<JsonStringList>& ServiceNames() const { return serviceNames_; }
    int32_t InstanceCount() const { return instanceCount_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("allNodes", self.allNodes_)
            .Field("nodeNames", self.nodeNames_)
            .Field("allServices", self.allServices_)
            .Field("serviceNames", self.serviceNames_)
            .Field("instanceCount", self.instanceCount_);
    }

    bool allNodes_ = false;
    std::optional<JsonStringList> nodeNames_;
    bool allServices_ = false;
    std::optional<JsonStringList> serviceNames_;
    int32_t instanceCount_ = 0;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
