#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/smtp/SmtpRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// Sends an e-mail from a given template, filled with fields, to a given address
// group.
class SmtpSendEmailToAddressGroupRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "SmtpSendEmailToAddressGroupRoutedMessage";

    SmtpSendEmailToAddressGroupRoutedMessage(std::optional<SmtpTemplateEntry> templateEntry,
                                             std::optional<SmtpAddressGroup> addressGroup,
                                             std::optional<JsonStringMap> fields);
    // Parses a received body.
    SmtpSendEmailToAddressGroupRoutedMessage(MessageBus::MessageHeaders headers,
                                             const MessageBus::MessageBody& body);

    const std::optional<SmtpTemplateEntry>& TemplateEntry() const { return templateEntry_; }
    const std::optional<SmtpAddressGroup>& AddressGroup() const { return addressGroup_; }
    const std::optional<JsonStringMap>& Fields() const { return fields_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("templateEntry", self.templateEntry_)
            .Field("addressGroup", self.addressGroup_)
            .Field("fields", self.fields_);
    }

    std::optional<SmtpTemplateEntry> templateEntry_;
    std::optional<SmtpAddressGroup> addressGroup_;
    std::optional<JsonStringMap> fields_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
