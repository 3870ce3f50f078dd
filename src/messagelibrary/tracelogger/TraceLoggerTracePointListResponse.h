#pragma once

#include <optional>
#include <string>
#include <vector>

#include "messagebus/interfaces/IRoutingSource.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageError.h"
#include "messagelibrary/MessageFields.h"
#include "messagelibrary/MessageHeaders.h"
#include "messagelibrary/ResponseMessage.h"
#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TraceLoggerMessages {

// The settings of the trace points.
class TraceLoggerTracePointListResponse : public MessageBus::ResponseMessage {
public:
    inline static const std::string kMessageName = "TraceLoggerTracePointListResponse";

    TraceLoggerTracePointListResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                      std::optional<std::vector<TracePointSetting>> settings);
    // An error response: the fields stay unset.
    TraceLoggerTracePointListResponse(const MessageBus::Interfaces::IRoutingSource& request,
                                      const MessageBus::MessageError& error);
    // Parses a received body.
    TraceLoggerTracePointListResponse(MessageBus::MessageHeaders headers,
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
