#include "utilities/tracelogging/TraceText.h"

#include <ctime>

#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

namespace Messages = VeldraMessageLibrary::TraceLoggerMessages;

VeldraMessageLibrary::Timestamp TraceTimeNow() {
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    const int64_t micros = static_cast<int64_t>(now.tv_sec) * 1000000 + now.tv_nsec / 1000;
    return VeldraMessageLibrary::TimestampFromTicks(VeldraMessageLibrary::kUnixEpochTicks + micros);
}

std::string ChildLoggerName(const std::string& parent, const std::string& name) {
    std::string full;
    full.reserve(parent.size() + 1 + name.size());
    full.append(parent).append(1, '.').append(name);
    return full;
}

std::string ErrorEntryText(const MessageBus::MessageError& error) {
    if (error.info.empty()) return error.FullName();
    return error.FullName() + ": " + error.info;
}

std::string ConsoleLine(const Messages::TraceEntry& entry) {
    std::string line = VeldraMessageLibrary::TimestampToText(entry.timestamp);
    if (line.empty() || line.back() != 'Z') line.push_back('Z');
    line.append(" | ").append(entry.moduleName.value_or(""));
    if (entry.tracePointName) line.append(" | ").append(*entry.tracePointName);
    line.append(" | ");
    if (entry.type == Messages::TraceEntryType::Error) line.append("ERROR - ");
    line.append(entry.text.value_or("")).append(1, '\n');
    return line;
}

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
