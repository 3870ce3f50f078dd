#pragma once

#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Answers ConfigurationSetKeysRequest; its body is empty.
class ConfigurationSetKeysResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "ConfigurationSetKeysResponse";

    explicit ConfigurationSetKeysResponse(const MessageBus::Interfaces::IRoutingSource& request);
    // An error response: the fields stay unset.
    ConfigurationSetKeysResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 const MessageBus::MessageError& error);
    // Parses a received body.
    ConfigurationSetKeysResponse(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
