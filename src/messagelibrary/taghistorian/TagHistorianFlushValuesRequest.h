#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RequestMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// Asks the historian to store the values it holds.
class TagHistorianFlushValuesRequest : public MessageBus::RequestMessage {
public:
    inline static const std::string kMessageName = "TagHistorianFlushValuesRequest";

    TagHistorianFlushValuesRequest();
    // Parses a received body.
    TagHistorianFlushValuesRequest(MessageBus::MessageHeaders headers,
                                   const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
