#include "utilities/tracelogging/TraceLogger.h"

#include <utility>

#include "utilities/tracelogging/TraceText.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

TraceLogger::TraceLogger(std::string name, std::shared_ptr<ProcessLogger> processLogger)
    : name_(std::move(name)), processLogger_(std::move(processLogger)) {}

TraceLogger::TraceLogger(const TraceLogger& parent, const std::string& name)
    : name_(ChildLoggerName(parent.name_, name)), processLogger_(parent.processLogger_) {}

MessageBus::TracePoint TraceLogger::GetTracePoint(const std::string& name) {
    return processLogger_->GetTracePoint(ChildLoggerName(name_, name));
}

void TraceLogger::Log(const MessageBus::TracePoint& tracePoint, const std::string& text) {
    if (!tracePoint.enabled) return;
    processLogger_->Take(name_, &tracePoint.name, text, TraceEntryType::Log);
}

void TraceLogger::Info(const std::string& text) {
    processLogger_->Take(name_, nullptr, text, TraceEntryType::Info);
}

void TraceLogger::Error(const std::string& text) {
    processLogger_->Take(name_, nullptr, text, TraceEntryType::Error);
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
