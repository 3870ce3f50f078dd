#pragma once

#include <string>

#include "messagelibrary/MessageError.h"
#include "messagelibrary/tracelogger/TraceLoggerRecords.h"

namespace Korvane::Veldra::VeldraUtilities::TraceLogging {

// The texts that both trace loggers make.

// The current time in UTC with microseconds, cheaper than the calendar
// clock of boost: the entries of a busy logger each take one.
VeldraMessageLibrary::Timestamp TraceTimeNow();
// "<parent>.<name>"; an empty name leaves "<parent>.".
std::string ChildLoggerName(const std::string& parent, const std::string& name);
// Full name, ": ", info; the full name alone when there is no info.
std::string ErrorEntryText(const MessageBus::MessageError& error);
// One console line with its newline: timestamp, "Z", " | ", module name,
// [" | ", trace point name,] " | ", text; an ERROR entry's text gets the
// prefix "ERROR - ".
std::string ConsoleLine(const VeldraMessageLibrary::TraceLoggerMessages::TraceEntry& entry);

}  // namespace Korvane::Veldra::VeldraUtilities::TraceLogging
