#pragma once

#include <optional>
#include <string>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/smtp/SmtpRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// Tells that an e-mail went out to an address group.
class SmtpPublishedEmailBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "SmtpPublishedEmailBroadcast";

    SmtpPublishedEmailBroadcast(std::optional<SmtpAddressGroup> addressGroup,
                                std::optional<std::string> subject,
                                std::optional<std::string> contents);
    // Parses a received body.
    SmtpPublishedEmailBroadcast(MessageBus::MessageHeaders headers,
                                const MessageBus::MessageBody& body);

    const std::optional<SmtpAddressGroup>& AddressGroup() const { return addressGroup_; }
    const std::optional<std::string>& Subject() const { return subject_; }
    const std::optional<std::string>& Contents() const { return contents_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("addressGroup", self.addressGroup_)
            .Field("subject", self.subject_)
            .Field("contents", self.contents_);
    }

    std::optional<SmtpAddressGroup> addressGroup_;
    std::optional<std::string> subject_;
    std::optional<std::string> contents_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
