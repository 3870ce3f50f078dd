#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/smtp/SmtpRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// Stores an address group, new or changed.
class SmtpUpdateOrCreateAddressGroupRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SmtpUpdateOrCreateAddressGroupRequest";

    explicit SmtpUpdateOrCreateAddressGroupRequest(std::optional<SmtpAddressGroup> addressGroup);
    // Parses a received body.
    SmtpUpdateOrCreateAddressGroupRequest(MessageBus::MessageHeaders headers,
                                          const MessageBus::MessageBody& body);

    const std::optional<SmtpAddressGroup>& AddressGroup() const { return addressGroup_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("addressGroup", self.addressGroup_);
    }

    std::optional<SmtpAddressGroup> addressGroup_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
