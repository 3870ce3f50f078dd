#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages {

// A manager's node and the names of its actors.
class SvcMgrGetActorTreeResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SvcMgrGetActorTreeResponse";

    SvcMgrGetActorTreeResponse(const MessageBus::Interfaces::IRoutingSource& request,
                               std::optional<std::string> nodeName,
                               std::optional<JsonStringList> actorList);
    // An error response: the fields stay unset.
    SvcMgrGetActorTreeResponse(const MessageBus::Interfaces::IRoutingSource& request,
                               const MessageBus::MessageError& error);
    // Parses a received body.
    SvcMgrGetActorTreeResponse(MessageBus::MessageHeaders headers,
                               const MessageBus::MessageBody& body);

    const std::optional<std::string>& NodeName() const { return nodeName_; }
    const std::optional<JsonStringList>& ActorList() const { return actorList_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("nodeName", self.nodeName_).Field("actorList", self.actorList_);
    }

    std::optional<std::string> nodeName_;
    std::optional<JsonStringList> actorList_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceManagerMessages
