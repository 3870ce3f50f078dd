#pragma once

#include <memory>

#include "messagebus/interfaces/IBroadcastCallback.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

class ProcessLogger;

// Receives the TraceLoggerSnapshotBroadcast for a ProcessLogger, which must
// outlive the service that delivers. The settings it carries are not applied
// to the points: a point keeps the state that GetTracePoint gave it.
class UpdateTracePointsCallback : public MessageBus::Interfaces::IBroadcastCallback {
public:
    explicit UpdateTracePointsCallback(ProcessLogger* logger) : logger_(logger) {}
    void OnMessage(std::shared_ptr<MessageBus::GenericMessage> message) override;

private:
    ProcessLogger* const logger_;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
