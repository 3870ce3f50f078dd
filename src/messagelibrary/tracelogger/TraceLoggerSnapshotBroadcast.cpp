#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/MessageFields.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerSnapshotBroadcast::TraceLoggerSnapshotBroadcast(
    std::optional<std::vector<TracePointSetting>> settings)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      settings_(std::move(settings)) {}

TraceLoggerSnapshotBroadcast::TraceLoggerSnapshotBroadcast(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    ReadMessageFields(*this, body);
}

MessageBus::MessageBody TraceLoggerSnapshotBroadcast::Serialize() const {
    return WriteMessageFields(*this);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
