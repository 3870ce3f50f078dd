#pragma once

#include <string>

#include "utilities/tracelogging/ITraceLogger.h"
#include "utilities/tracelogging/ProcessLogger.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

// Writes each entry at once as one line on standard output. Its points are
// never enabled, yet Log prints whatever point it is given.
class ConsoleLogger : public MessageBus::Interfaces::ITraceLogger {
public:
    explicit ConsoleLogger(std::string name) : name_(std::move(name)) {}

    const std::string& GetName() const override { return name_; }
    MessageBus::TracePoint GetTracePoint(const std::string& name) override;
    void Log(const MessageBus::TracePoint& tracePoint, const std::string& text) override;
    void Info(const std::string& text) override;
    void Error(const std::string& text) override;
    using ITraceLogger::Error;

private:
    void Print(const std::string* tracePointName, const std::string& text,
               TraceEntryType type) const;

    const std::string name_;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
