#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Sets the value of one key of a section on behalf of a user.
class ConfigurationSetValueRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "ConfigurationSetValueRequest";

    ConfigurationSetValueRequest(std::optional<std::string> user,
                                 std::optional<std::string> section, std::optional<std::string> key,
                                 std::optional<std::string> value);
    // Parses a received body.
    ConfigurationSetValueRequest(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::string>& User() const { return user_; }
    const std::optional<std::string>& Section() const { return section_; }
    const std::optional<std::string>& Key() const { return key_; }
    const std::optional<std::string>& Value() const { return value_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("user", self.user_)
            .Field("section", self.section_)
            .Field("key", self.key_)
            .Field("value", self.value_);
    }

    std::optional<std::string> user_;
    std::optional<std::string> section_;
    std::optional<std::string> key_;
    std::optional<std::string> value_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
