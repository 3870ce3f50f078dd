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
#include "messagelibrary/taghttp/TagSelection.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

// All selections.
class TagHttpGetSelectionsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagHttpGetSelectionsResponse";

    TagHttpGetSelectionsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 std::optional<std::vector<TagSelection>> selections);
    // An error response: the fields stay unset.
    TagHttpGetSelectionsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 const MessageBus::MessageError& error);
    // Parses a received body.
    TagHttpGetSelectionsResponse(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::vector<TagSelection>>& Selections() const { return selections_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("selections", self.selections_);
    }

    std::optional<std::vector<TagSelection>> selections_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
