#pragma once

#include <cstdint>

#include "kvveldra/WBTypes.h"
#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::TagLibrary {

using VeldraMessageLibrary::Timestamp;

// Seconds between the host's epoch, 1904-01-01, and 1970-01-01.
constexpr int64_t kHostEpochOffsetSeconds = 2082844800;

// The host's time as whole seconds and a signed fraction of a second with
// the sign of the seconds, before it is packed into the 128-bit form.
struct HostTimeParts {
    int64_t seconds;
    double fraction;
};

// Timestamp to host time. The special values are taken as boundless
// differences, so their results are fixed numbers far out in time.
HostTimeParts TimestampToHostParts(const Timestamp& timestamp);
WBTimestamp PackHostTime(const HostTimeParts& parts);
WBTimestamp TimestampToHostTime(const Timestamp& timestamp);

// Host time to timestamp, through the calendar: a date outside the years
// 1400 to 10000 throws std::out_of_range with the calendar's text.
Timestamp HostTimeToTimestamp(const WBTimestamp& hostTime);

// A host timestamp of all zero bytes stands for "no timestamp".
inline bool IsZeroHostTime(const WBTimestamp& hostTime) {
    return hostTime.seconds == 0 && hostTime.fraction == 0;
}

}  // namespace Korvane::Veldra::TagLibrary
