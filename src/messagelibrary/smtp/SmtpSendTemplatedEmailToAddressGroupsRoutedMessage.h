#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/json/JsonReaders.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// Sends an e-mail from a stored template, filled with fields, to a stored address
// group; both by id.
class SmtpSendTemplatedEmailToAddressGroupsRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName =
        "SmtpSendTemplatedEmailToAddressGroupsRoutedMessage";

    SmtpSendTemplatedEmailToAddressGroupsRoutedMessage(std::optional<std::string> templateId,
                                                       std::optional<std::string> addressGroupId,
                                                       std::optional<JsonStringMap> fields);
    // Parses a received body.
    SmtpSendTemplatedEmailToAddressGroupsRoutedMessage(MessageBus::MessageHeaders headers,
                                                       const MessageBus::MessageBody& body);

    const std::optional<std::string>& TemplateId() const { return templateId_; }
    const std::optional<std::string>& AddressGroupId() const { return addressGroupId_; }
    const std::optional<JsonStringMap>& Fields() const { return fields_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("templateId", self.templateId_)
            .Field("addressGroupId", self.addressGroupId_)
            .Field("fields", self.fields_);
    }

    std::optional<std::string> templateId_;
    std::optional<std::string> addressGroupId_;
    std::optional<JsonStringMap> fields_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
