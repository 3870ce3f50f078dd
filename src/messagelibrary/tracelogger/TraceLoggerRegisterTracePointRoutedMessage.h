#pragma once

#include <optional>
#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// Makes a trace point known to the service, by its full name.
class TraceLoggerRegisterTracePointRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerRegisterTracePointRoutedMessage";

    explicit TraceLoggerRegisterTracePointRoutedMessage(std::optional<std::string> tracePointName);
    // Parses a received body.
    TraceLoggerRegisterTracePointRoutedMessage(MessageBus::MessageHeaders headers,
                                               const MessageBus::MessageBody& body);

    const std::optional<std::string>& TracePointName() const { return tracePointName_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("tracePointName", self.tracePointName_);
    }

    std::optional<std::string> tracePointName_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
