#pragma once

#include <string>

#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/RoutedMessage.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// Asks the service to broadcast the settings of the trace points.
class TraceLoggerBroadcastTracePointsRoutedMessage : public MessageBus::RoutedMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerBroadcastTracePointsRoutedMessage";

    TraceLoggerBroadcastTracePointsRoutedMessage();
    // Parses a received body.
    TraceLoggerBroadcastTracePointsRoutedMessage(MessageBus::MessageHeaders headers,
                                                 const MessageBus::MessageBody& body);

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self&, Fields&) {}
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
