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

// "YYYY-MM-DDThh:mm:ss.ffffffZ" in UTC; "" for the two boundless times,
// which stand for no time.
std::string FormatIsoTime(TagConsoleTime time);

// The current time, to the microsecond.
TagConsoleTime NowTime();

}  // namespace kvtag
