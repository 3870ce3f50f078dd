#pragma once

#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Asks every service to send its status.
class SvcMgrSendServiceStatusRequestBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SvcMgrSendServiceStatusRequestBroadcast";

    SvcMgrSendServiceStatusRequestBroadcast();
    // Parses a received body.
    SvcMgrSendServiceStatusRequestBroadcast(MessageBus::MessageHeaders headers,
                                            const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
