#pragma once

#include <optional>
#include <string>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Confirms the end of a subscription to stored values.
class TagHistorianAsyncUnsubscribeResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TagHistorianAsyncUnsubscribeResponse";

    explicit TagHistorianAsyncUnsubscribeResponse(
        const MessageBus::Interfaces::IRoutingSource& request);
    // An error response.
    TagHistorianAsyncUnsubscribeResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                         const MessageBus::MessageError& error);
    // Parses a received body.
    TagHistorianAsyncUnsubscribeResponse(MessageBus::MessageHeaders headers,
                                         const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
