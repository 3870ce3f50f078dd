#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/taghttp/TagSelection.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages {

// One selection.
class TagHttpGetSelectionResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagHttpGetSelectionResponse";

    TagHttpGetSelectionResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                std::optional<TagSelection> selection);
    // An error response: the fields stay unset.
    TagHttpGetSelectionResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                const MessageBus::MessageError& error);
    // Parses a received body.
    TagHttpGetSelectionResponse(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<TagSelection>& Selection() const { return selection_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("selection", self.selection_);
    }

    std::optional<TagSelection> selection_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHttpMessages
