#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Sets keys of a section on behalf of a user.
class ConfigurationSetKeysRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "ConfigurationSetKeysRequest";

    ConfigurationSetKeysRequest(std::optional<std::string> user, std::optional<std::string> section,
                                std::optional<JsonStringMap> keys);
    // Parses a received body.
    ConfigurationSetKeysRequest(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<std::string>& User() const { return user_; }
    const std::optional<std::string>& Section() const { return section_; }
    const std::optional<JsonStringMap>& Keys() const { return keys_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("user", self.user_).Field("section", self.section_).Field("keys", self.keys_);
    }

    std::optional<std::string> user_;
    std::optional<std::string> section_;
    std::optional<JsonStringMap> keys_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
