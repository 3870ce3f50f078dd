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

// One address group. Its key is "addressGroups", plural, as the peers write it.
class SmtpGetAddressGroupResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SmtpGetAddressGroupResponse";

    SmtpGetAddressGroupResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                std::optional<SmtpAddressGroup> addressGroups);
    // An error response: the fields stay unset.
    SmtpGetAddressGroupResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                const MessageBus::MessageError& error);
    // Parses a received body.
    SmtpGetAddressGroupResponse(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<SmtpAddressGroup>& AddressGroups() const { return addressGroups_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("addressGroups", self.addressGroups_);
    }

    std::optional<SmtpAddressGroup> addressGroups_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
