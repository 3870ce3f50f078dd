#include "utilities/tracelogging/UpdateTracePointsCallback.h"

#include "messagelibrary/tracelogger/TraceLoggerSnapshotBroadcast.h"
#include "utilities/tracelogging/ProcessLogger.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

void UpdateTracePointsCallback::OnMessage(std::shared_ptr<MessageBus::GenericMessage> message) {
    if (!message) return;
    const VeldraMessageLibrary::TraceLoggerMessages::TraceLoggerSnapshotBroadcast snapshot(
        message->Headers(), message->Body());
    const auto& settings = snapshot.Settings();
    logger_->OnSnapshot(!settings || settings->empty());
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
