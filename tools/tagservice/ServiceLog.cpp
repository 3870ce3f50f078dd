#include "ServiceLog.h"

#include <iostream>

#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::TagService {

void WriteLogLine(std::ostream& out, const std::string& text) {
    // One insertion of the whole line, so that lines of two threads do not mix.
    const std::string line =
        VeldraMessageLibrary::TimestampToText(boost::posix_time::microsec_clock::universal_time()) +
        " | tagservice | " + text + "\n";
    out.write(line.data(), static_cast<std::streamsize>(line.size()));
    out.flush();
}

MessageBus::TracePoint ConsoleTraceLogger::GetTracePoint(const std::string& name) {
    return MessageBus::TracePoint(name);
}

void ConsoleTraceLogger::Log(const MessageBus::TracePoint& point, const std::string& text) {
    if (point.enabled) WriteLogLine(std::cerr, point.name + " | " + text);
}

void ConsoleTraceLogger::Info(const std::string& text) {
    WriteLogLine(std::cerr, text);
}

void ConsoleTraceLogger::Error(const std::string& text) {
    WriteLogLine(std::cerr, "ERROR " + text);
}

}  // namespace Korvane::Veldra::TagService
