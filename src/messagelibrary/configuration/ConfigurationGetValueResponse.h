#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// The value of one key.
class ConfigurationGetValueResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetValueResponse";

    ConfigurationGetValueResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                  std::optional<std::string> value);
    // An error response: the fields stay unset.
    ConfigurationGetValueResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                  const MessageBus::MessageError& error);
    // Parses a received body.
    ConfigurationGetValueResponse(MessageBus::MessageHeaders headers,
                                  const MessageBus::MessageBody& body);

    const std::optional<std::string>& Value() const { return value_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("value", self.value_);
    }

    std::optional<std::string> value_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
