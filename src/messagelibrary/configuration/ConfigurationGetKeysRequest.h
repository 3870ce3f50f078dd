#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Asks for the keys and values of one section.
class ConfigurationGetKeysRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetKeysRequest";

    explicit ConfigurationGetKeysRequest(std::optional<std::string> section);
    // Parses a received body.
    ConfigurationGetKeysRequest(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<std::string>& Section() const { return section_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("section", self.section_);
    }

    std::optional<std::string> section_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
