#pragma once

#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Asks every manager to forget its stopped services.
class SvcMgrPurgeStoppedServicesRequestBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrPurgeStoppedServicesRequestBroadcast";

    SvcMgrPurgeStoppedServicesRequestBroadcast();
    // Parses a received body.
    SvcMgrPurgeStoppedServicesRequestBroadcast(MessageBus::MessageHeaders headers,
                                               const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
