#pragma once

#include <memory>
#include <string>

#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::VeldraUtilities {

// Writes each entry to the first logger, which owns the trace points, and
// echoes it to the second.
class EchoTraceLogger : public MessageBus::Interfaces::ITraceLogger {
public:
    EchoTraceLogger(std::shared_ptr<ITraceLogger> primary, std::shared_ptr<ITraceLogger> echo);

    const std::string& GetName() const override { return primary_->GetName(); }
    MessageBus::TracePoint GetTracePoint(const std::string& name) override;
    void Log(const MessageBus::TracePoint& tracePoint, const std::string& text) override;
    void Info(const std::string& text) override;
    void Error(const std::string& text) override;
    using ITraceLogger::Error;

private:
    const std::shared_ptr<ITraceLogger> primary_;
    const std::shared_ptr<ITraceLogger> echo_;
};

}  // namespace Korvane::Veldra::VeldraUtilities
