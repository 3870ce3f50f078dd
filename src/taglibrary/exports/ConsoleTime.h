#pragma once

#include "kvveldra/TagConsole.h"
#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::TagLibrary {

// The console family's times and the timestamps of messages. min() and max()
// are the two infinities; not-a-date-time reads as min(), which goes out
// with the same text.
VeldraMessageLibrary::Timestamp ConsoleTimeToTimestamp(TagConsoleTime time);
TagConsoleTime TimestampToConsoleTime(const VeldraMessageLibrary::Timestamp& timestamp);

}  // namespace Korvane::Veldra::TagLibrary
