#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages {

// Asks for the list of e-mail templates.
class SmtpGetTemplateListItemsRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "SmtpGetTemplateListItemsRequest";

    SmtpGetTemplateListItemsRequest();
    // Parses a received body.
    SmtpGetTemplateListItemsRequest(MessageBus::MessageHeaders headers,
                                    const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::SmtpMessages
