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
#include "messagelibrary/smtp/SmtpRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// The e-mail templates, without subject and contents.
class SmtpGetTemplateListItemsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SmtpGetTemplateListItemsResponse";

    SmtpGetTemplateListItemsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                     std::optional<std::vector<SmtpTemplateListItem>> templates);
    // An error response: the fields stay unset.
    SmtpGetTemplateListItemsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                     const MessageBus::MessageError& error);
    // Parses a received body.
    SmtpGetTemplateListItemsResponse(MessageBus::MessageHeaders headers,
                                     const MessageBus::MessageBody& body);

    const std::optional<std::vector<SmtpTemplateListItem>>& Templates() const { return templates_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("templates", self.templates_);
    }

    std::optional<std::vector<SmtpTemplateListItem>> templates_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
