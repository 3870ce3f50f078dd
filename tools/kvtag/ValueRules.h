#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace kvtag {

// The text to send for a value of a tag of `type`, or nothing when a tag of
// that type cannot hold it. double: a decimal or exponent number, or nan /
// inf; int32: a decimal integer within 32 bits; uint64: decimal digits within
// 64 bits; bool: true/false (any case) or 1/0, sent as "True" / "False";
// datetime: an ISO 8601 time with a zone, sent as UTC with microseconds;
// string: anything without a zero byte. Numbers go out as given.
std::optional<std::string> NormalizeValue(int32_t type, const std::string& text);

// Why NormalizeValue refuses the text: "'TEXT' is not a value of type T",
// with the reason when there is a plain one (a double beyond the range, a
// date-time without a zone).
std::string ValueRefusal(int32_t type, const std::string& text);

}  // namespace kvtag
