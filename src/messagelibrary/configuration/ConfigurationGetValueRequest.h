#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Asks for the value of one key of a section.
class ConfigurationGetValueRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetValueRequest";

    ConfigurationGetValueRequest(std::optional<std::string> section,
                                 std::optional<std::string> key);
    // Parses a received body.
    ConfigurationGetValueRequest(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::string>& Section() const { return section_; }
    const std::optional<std::string>& Key() const { return key_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("section", self.section_).Field("key", self.key_);
    }

    std::optional<std::string> section_;
    std::optional<std::string> key_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
