#include "utilities/tracelogging/ConsoleLogger.h"

#include <cstdio>

#include "utilities/tracelogging/TraceText.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

MessageBus::TracePoint ConsoleLogger::GetTracePoint(const std::string& name) {
    return MessageBus::TracePoint(name);
}

void ConsoleLogger::Log(const MessageBus::TracePoint& tracePoint, const std::string& text) {
    Print(&tracePoint.name, text, TraceEntryType::Log);
}

void ConsoleLogger::Info(const std::string& text) {
    Print(nullptr, text, TraceEntryType::Info);
}

void ConsoleLogger::Error(const std::string& text) {
    Print(nullptr, text, TraceEntryType::Error);
}

void ConsoleLogger::Print(const std::string* tracePointName, const std::string& text,
                          TraceEntryType type) const {
    TraceEntry entry;
    entry.moduleName = name_;
    entry.timestamp = TraceTimeNow();
    if (tracePointName != nullptr) entry.tracePointName = *tracePointName;
    entry.text = text;
    entry.type = type;
    const std::string line = ConsoleLine(entry);
    // One write per line, so lines of several threads do not interleave.
    std::fwrite(line.data(), 1, line.size(), stdout);
    std::fflush(stdout);
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
