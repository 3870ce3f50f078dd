#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// The id of the stored address group.
class SmtpUpdateOrCreateAddressGroupResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "SmtpUpdateOrCreateAddressGroupResponse";

    SmtpUpdateOrCreateAddressGroupResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                           std::optional<std::string> id);
    // An error response: the fields stay unset.
    SmtpUpdateOrCreateAddressGroupResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                           const MessageBus::MessageError& error);
    // Parses a received body.
    SmtpUpdateOrCreateAddressGroupResponse(MessageBus::MessageHeaders headers,
                                           const MessageBus::MessageBody& body);

    const std::optional<std::string>& Id() const { return id_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("id", self.id_);
    }

    std::optional<std::string> id_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
