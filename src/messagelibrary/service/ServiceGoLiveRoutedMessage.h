#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages {

// Tells a registered service to go live.
class ServiceGoLiveRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "ServiceGoLiveRoutedMessage";

    ServiceGoLiveRoutedMessage(const std::string& target, std::optional<std::string> serviceGuid);
    // Parses a received body.
    ServiceGoLiveRoutedMessage(MessageBus::MessageHeaders headers,
                               const MessageBus::MessageBody& body);

    const std::optional<std::string>& ServiceGuid() const { return serviceGuid_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("serviceGuid", self.serviceGuid_);
    }

    std::optional<std::string> serviceGuid_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::ServiceMessages
