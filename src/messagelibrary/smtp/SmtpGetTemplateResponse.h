#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/smtp/SmtpRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// One whole e-mail template.
class SmtpGetTemplateResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SmtpGetTemplateResponse";

    SmtpGetTemplateResponse(const MessageBus::Interfaces::IRoutingSource& request,
                            std::optional<SmtpTemplateEntry> templateEntry);
    // An error response: the fields stay unset.
    SmtpGetTemplateResponse(const MessageBus::Interfaces::IRoutingSource& request,
                            const MessageBus::MessageError& error);
    // Parses a received body.
    SmtpGetTemplateResponse(MessageBus::MessageHeaders headers,
                            const MessageBus::MessageBody& body);

    const std::optional<SmtpTemplateEntry>& TemplateEntry() const { return templateEntry_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("templateEntry", self.templateEntry_);
    }

    std::optional<SmtpTemplateEntry> templateEntry_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
