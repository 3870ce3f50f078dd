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
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages {

// The current values asked for, with their aggregates.
class TagCvQueryCurrentValuesByPathResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagCvQueryCurrentValuesByPathResponse";

    TagCvQueryCurrentValuesByPathResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                          std::optional<std::vector<TagCurrentValue>> values);
    // An error response: the fields stay unset.
    TagCvQueryCurrentValuesByPathResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                          const MessageBus::MessageError& error);
    // Parses a received body.
    TagCvQueryCurrentValuesByPathResponse(MessageBus::MessageHeaders headers,
                                          const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagCurrentValue>>& Values() const { return values_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("values", self.values_);
    }

    std::optional<std::vector<TagCurrentValue>> values_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagCurrentValueMessages
