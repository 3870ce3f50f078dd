#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

// Tells a live service to go idle.
class ServiceMakeIdleRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "ServiceMakeIdleRoutedMessage";

    explicit ServiceMakeIdleRoutedMessage(const std::string& target);
    // Parses a received body.
    ServiceMakeIdleRoutedMessage(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
