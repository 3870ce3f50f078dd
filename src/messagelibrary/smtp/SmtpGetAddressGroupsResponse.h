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

// All address groups.
class SmtpGetAddressGroupsResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SmtpGetAddressGroupsResponse";

    SmtpGetAddressGroupsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 std::optional<std::vector<SmtpAddressGroup>> addressGroups);
    // An error response: the fields stay unset.
    SmtpGetAddressGroupsResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                 const MessageBus::MessageError& error);
    // Parses a received body.
    SmtpGetAddressGroupsResponse(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::vector<SmtpAddressGroup>>& AddressGroups() const {
        return addressGroups_;
    }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("addressGroups", self.addressGroups_);
    }

    std::optional<std::vector<SmtpAddressGroup>> addressGroups_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
