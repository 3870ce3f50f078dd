#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Asks for every section with its keys and values.
class ConfigurationGetSectionKeyValuesRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetSectionKeyValuesRequest";

    ConfigurationGetSectionKeyValuesRequest();
    // Parses a received body.
    ConfigurationGetSectionKeyValuesRequest(MessageBus::MessageHeaders headers,
                                            const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
