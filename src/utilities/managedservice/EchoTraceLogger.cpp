#include "utilities/managedservice/EchoTraceLogger.h"

#include <utility>

namespace Korvane::Veldra::VeldraUtilities {

EchoTraceLogger::EchoTraceLogger(std::shared_ptr<ITraceLogger> primary,
                                 std::shared_ptr<ITraceLogger> echo)
    : primary_(std::move(primary)), echo_(std::move(echo)) {}

MessageBus::TracePoint EchoTraceLogger::GetTracePoint(const std::string& name) {
    return primary_->GetTracePoint(name);
}

void EchoTraceLogger::Log(const MessageBus::TracePoint& tracePoint, const std::string& text) {
    primary_->Log(tracePoint, text);
    // The echo sees the entry whether or not the bus side has the point on.
    MessageBus::TracePoint echoed = tracePoint;
    echoed.enabled = true;
    echo_->Log(echoed, text);
}

void EchoTraceLogger::Info(const std::string& text) {
    primary_->Info(text);
    echo_->Info(text);
}

void EchoTraceLogger::Error(const std::string& text) {
    primary_->Error(text);
    echo_->Error(text);
}

}  // namespace Korvane::Veldra::VeldraUtilities
