#pragma once

#include <ostream>
#include <string>

#include "utilities/tracelogging/ITraceLogger.h"

namespace Korvane::Veldra::TagService {

// Writes one line in the console form: timestamp, " | tagservice | ", text.
void WriteLogLine(std::ostream& out, const std::string& text);

// Errors and information go to standard error; of the trace points only
// those enabled.
class ConsoleTraceLogger : public MessageBus::Interfaces::ITraceLogger {
public:
    MessageBus::TracePoint GetTracePoint(const std::string& name) override;
    void Log(const MessageBus::TracePoint& point, const std::string& text) override;
    void Info(const std::string& text) override;
    void Error(const std::string& text) override;
    using ITraceLogger::Error;
};

}  // namespace Korvane::Veldra::TagService
