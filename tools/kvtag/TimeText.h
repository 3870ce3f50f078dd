#pragma once

#include <kvveldra/TagConsole.h>

#include <optional>
#include <string>
#include <string_view>

namespace kvtag {

// Parses an ISO 8601 date and time with an explicit zone:
// YYYY-MM-DDThh:mm:ss[.f...]Z or with an offset +hh:mm / -hh:mm, at most six
// fraction digits, years 1..9999. Nothing for any other text.
std::optional<TagConsoleTime> ParseIsoTime(std::string_view text);

// True when the text is a date and time that only lacks its zone, such as
// "2026-03-01T08:30:00": one that ParseIsoTime takes once "Z" is added.
bool LacksOnlyAZone(std::string_view text);

// The advice for such a text, to follow a message about it.
inline constexpr const char* kAddAZone = "add Z (UTC) or an offset such as +01:00";

// "YYYY-MM-DDThh:mm:ss.ffffffZ" in UTC; "" for the two boundless times,
// which stand for no time.
std::string FormatIsoTime(TagConsoleTime time);

// The current time, to the microsecond.
TagConsoleTime NowTime();

}  // namespace kvtag
