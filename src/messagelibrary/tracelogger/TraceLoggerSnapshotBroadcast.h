#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/BroadcastMessage.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// The settings of the trace points.
class TraceLoggerSnapshotBroadcast : public MessageBus::BroadcastMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerSnapshotBroadcast";

    explicit TraceLoggerSnapshotBroadcast(std::optional<std::vector<TracePointSetting>> settings);
    // Parses a received body.
    TraceLoggerSnapshotBroadcast(MessageBus::MessageHeaders headers,
                                 const MessageBus::MessageBody& body);

    const std::optional<std::vector<TracePointSetting>>& Settings() const { return settings_; }

    MessageBus::MessageBody Serialize() const override;

private:
    friend struct VeldraMessageLibrary::JsonFieldAccess;
    template <typename Self, typename Fields>
    static void JsonFields(Self& self, Fields& fields) {
        fields.Field("settings", self.settings_);
    }

    std::optional<std::vector<TracePointSetting>> settings_;
};

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages
