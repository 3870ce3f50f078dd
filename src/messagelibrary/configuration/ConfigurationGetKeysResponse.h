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

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// The keys of a section with their values.
class ConfigurationGetKeysResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetKeysResponse";

    ConfigurationGetKeysResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 std::optional<JsonStringMap> keys);
    // An error response: the fields stay unset.
    ConfigurationGetKeysResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 const MessageBus::MessageError& error);
    // Parses a received body.
    ConfigurationGetKeysResponse(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<JsonStringMap>& Keys() const { return keys_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("keys", self.keys_);
    }

    std::optional<JsonStringMap> keys_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
