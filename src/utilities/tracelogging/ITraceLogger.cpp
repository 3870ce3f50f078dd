#include "utilities/tracelogging/ITraceLogger.h"

#include "utilities/tracelogging/TraceText.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

const std::string& ITraceLogger::GetName() const {
    static const std::string kNoName;
    return kNoName;
}

void ITraceLogger::Info(const std::string&) {}

void ITraceLogger::Error(const MessageError* error) {
    if (error != nullptr) Error(VeldraUtilities::TraceLogging::ErrorEntryText(*error));
}

void ITraceLogger::Assert(bool condition, const std::string& text) {
    if (!condition) Error(text);
}

}  // namespace Korvane::Veldra::MessageBus::Interfaces
