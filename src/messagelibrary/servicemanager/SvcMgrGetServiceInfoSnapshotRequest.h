#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// Asks a manager for the services it knows.
class SvcMgrGetServiceInfoSnapshotRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SvcMgrGetServiceInfoSnapshotRequest";

    explicit SvcMgrGetServiceInfoSnapshotRequest(const std::string& target);
    // Parses a received body.
    SvcMgrGetServiceInfoSnapshotRequest(MessageBus::MessageHeaders headers,
                                        const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
