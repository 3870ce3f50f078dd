#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

// The call of a registered timer; token is the one given at registration.
class TimerCallbackResponseRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TimerCallbackResponseRoutedMessage";

    explicit TimerCallbackResponseRoutedMessage(std::optional<std::string> token);
    // Parses a received body.
    TimerCallbackResponseRoutedMessage(MessageBus::MessageHeaders headers,
                                       const MessageBus::MessageBody& body);

    const std::optional<std::string>& Token() const { return token_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("token", self.token_);
    }

    std::optional<std::string> token_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
