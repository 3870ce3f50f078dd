#pragma once

#include <boost/date_time/posix_time/posix_time_types.hpp>
#include <cstdint>
#include <cstddef>
#include <string>
#include <string_view>

namespace Korvane::Veldra::VeldraMessageLibrary {

// A UTC point with microsecond resolution and three special values:
// not-a-date-time, +infinity and -infinity.
using Timestamp = boost::posix_time::ptime;

// The raw count: microseconds since the start of Julian day 0.
constexpr int64_t kUnixEpochTicks = 210866803200000000LL;
constexpr int64_t kNotADateTimeTicks = 0x7FFFFFFFFFFFFFFELL;
constexpr int64_t kPosInfinityTicks = 0x7FFFFFFFFFFFFFFFLL;
constexpr int64_t kNegInfinityTicks = static_cast<int64_t>(0x8000000000000000ULL);

int64_t TimestampToTicks(const Timestamp& timestamp);
// A count before 1400-01-01 gives -infinity, one beyond 9999-12-31 +infinity.
Timestamp TimestampFromTicks(int64_t ticks);

// Microseconds since 1970-01-01; the special values give their raw counts, as
// a boundless difference would.
int64_t MicrosecondsSinceUnixEpoch(const Timestamp& timestamp);

// The wall clock in seconds since 1970; a result that would land on a special
// count keeps that special value, one outside the calendar saturates.
Timestamp TimestampFromUnixSeconds(int64_t seconds);

// "YYYY-MM-DDThh:mm:ss[.ffffff]Z"; not-a-date-time and -infinity give
// "0001-01-01T00:00:00", +infinity "9999-12-31T23:59:59.9999999".
std::string TimestampToText(const Timestamp& timestamp);
// Appends the same text to out, for writers that build a body in place.
void AppendTimestampText(const Timestamp& timestamp, std::string& out);
// The most bytes that text takes.
constexpr std::size_t kTimestampTextMax = 32;
// Writes the same text at out, which has room for kTimestampTextMax bytes;
// returns the end of what it wrote.
char* WriteTimestampText(const Timestamp& timestamp, char* out);

// Reads the text form. Returns false, leaving result unchanged, when refused;
// a text whose hours roll beyond 9999-12-31 is refused too.
bool ParseTimestamp(std::string_view text, Timestamp& result);
// The same rules for a zero-terminated text, without the special-value
// shortcut for "0001-01-01T00:00:00". Used for DATE_TIME tag values.
bool ParseTimestampZ(const char* text, Timestamp& result);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
