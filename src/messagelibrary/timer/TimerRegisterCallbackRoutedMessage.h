#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"
#include "messagelibrary/timer/TimerCallbackType.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

// Registers a timer that calls back after elapsedMinutes, once or again and again.
// token comes back in every call; elapsedMinutes is written as a bare number,
// NaN and Infinity included.
class TimerRegisterCallbackRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TimerRegisterCallbackRoutedMessage";

    TimerRegisterCallbackRoutedMessage(std::optional<TimerCallbackType> callbackType,
                                       double elapsedMinutes, std::optional<std::string> token);
    // Parses a received body.
    TimerRegisterCallbackRoutedMessage(MessageBus::MessageHeaders headers,
                                       const MessageBus::MessageBody& body);

    const std::optional<TimerCallbackType>& CallbackType() const { return callbackType_; }
    double ElapsedMinutes() const { return elapsedMinutes_; }
    const std::optional<std::string>& Token() const { return token_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("callbackType", self.callbackType_)
            .Field("elapsedMinutes", self.elapsedMinutes_)
            .Field("token", self.token_);
    }

    std::optional<TimerCallbackType> callbackType_;
    double elapsedMinutes_ = 0.0;
    std::optional<std::string> token_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
