#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages {

// Asks for the names of the sections.
class ConfigurationGetSectionsRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetSectionsRequest";

    ConfigurationGetSectionsRequest();
    // Parses a received body.
    ConfigurationGetSectionsRequest(MessageBus::MessageHeaders headers,
                                    const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
