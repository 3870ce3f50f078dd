#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"

#include <utility>

#include "messagelibrary/ContentTypes.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

TraceLoggerSnapshotBroadcast::TraceLoggerSnapshotBroadcast(
    std::optional<std::vector<TracePointSetting>> settings)
    : MessageBus::BroadcastMessage(kMessageName, MessageBus::kJsonContentType),
      settings_(std::move(settings)) {}

TraceLoggerSnapshotBroadcast::TraceLoggerSnapshotBroadcast(MessageBus::MessageHeaders headers,
                                                           const MessageBus::MessageBody& body)
    : MessageBus::BroadcastMessage(std::move(headers)) {
    const JsonVariant json = ParseJsonBody(body.ToString(), MessageType());
    JsonBodyReader(json).Field("settings", settings_);
}

MessageBus::MessageBody TraceLoggerSnapshotBroadcast::Serialize() const {
    return MessageBus::MessageBody(JsonBodyWriter().Field("settings", settings_).Finish());
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
