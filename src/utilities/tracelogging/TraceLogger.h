#pragma once

#include <memory>
#include <string>

#include "utilities/tracelogging/ITraceLogger.h"
#include "utilities/tracelogging/ProcessLogger.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

// Hands its entries to a ProcessLogger, under its own name as module name.
class TraceLogger : public MessageBus::Interfaces::ITraceLogger {
public:
    TraceLogger(std::string name, std::shared_ptr<ProcessLogger> processLogger);
    // A logger named "<parent>.<name>" on the parent's ProcessLogger.
    TraceLogger(const TraceLogger& parent, const std::string& name);

    const std::string& GetName() const override { return name_; }
    MessageBus::TracePoint GetTracePoint(const std::string& name) override;
    void Log(const MessageBus::TracePoint& tracePoint, const std::string& text) override;
    void Info(const std::string& text) override;
    void Error(const std::string& text) override;
    using ITraceLogger::Error;

private:
    const std::string name_;
    const std::shared_ptr<ProcessLogger> processLogger_;
};

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
