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

// The names of the sections.
class ConfigurationGetSectionsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "ConfigurationGetSectionsResponse";

    ConfigurationGetSectionsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                     std::optional<JsonStringList> sections);
    // An error response: the fields stay unset.
    ConfigurationGetSectionsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                     const MessageBus::MessageError& error);
    // Parses a received body.
    ConfigurationGetSectionsResponse(MessageBus::MessageHeaders headers,
                                     const MessageBus::MessageBody& body);

    const std::optional<JsonStringList>& Sections() const { return sections_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("sections", self.sections_);
    }

    std::optional<JsonStringList> sections_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ConfigurationMessages
