#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/smtp/SmtpRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// Stores an e-mail template, new or changed.
class SmtpUpdateOrCreateTemplateRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SmtpUpdateOrCreateTemplateRequest";

    explicit SmtpUpdateOrCreateTemplateRequest(std::optional<SmtpTemplateEntry> templateEntry);
    // Parses a received body.
    SmtpUpdateOrCreateTemplateRequest(MessageBus::MessageHeaders headers,
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
