#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/configuration/ConfigurationRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Every section with its keys and values.
class ConfigurationGetSectionKeyValuesResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetSectionKeyValuesResponse";

    ConfigurationGetSectionKeyValuesResponse(
        const MessageBus::Interfaces::IRoutingSource& request,
        std::optional<std::vector<ConfigurationSectionKeyValues>> keyValues);
    // An error response: the fields stay unset.
    ConfigurationGetSectionKeyValuesResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                             const MessageBus::MessageError& error);
    // Parses a received body.
    ConfigurationGetSectionKeyValuesResponse(MessageBus::MessageHeaders headers,
                                             const MessageBus::MessageBody& body);

    const std::optional<std::vector<ConfigurationSectionKeyValues>>& KeyValues() const {
        return keyValues_;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("keyValues", self.keyValues_);
    }

    std::optional<std::vector<ConfigurationSectionKeyValues>> keyValues_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
