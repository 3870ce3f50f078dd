#include "taglibrary/exports/ConsoleTime.h"

#include <limits>

namespace Korvane::Veldra::TagLibrary {

using namespace VeldraMessageLibrary;

Timestamp ConsoleTimeToTimestamp(TagConsoleTime time) {
    if (time == TagConsoleTime::max()) return Timestamp(boost::posix_time::pos_infin);
    if (time == TagConsoleTime::min()) return Timestamp(boost::posix_time::neg_infin);
    const int64_t micros = time.time_since_epoch().count();
    // Beyond the range of the count: the boundless time on that side.
    if (micros > std::numeric_limits<int64_t>::max() - kUnixEpochTicks)
        return Timestamp(boost::posix_time::pos_infin);
    if (micros < -kUnixEpochTicks) return Timestamp(boost::posix_time::neg_infin);
    return TimestampFromTicks(kUnixEpochTicks + micros);
}

TagConsoleTime TimestampToConsoleTime(const Timestamp& timestamp) {
    if (timestamp.is_pos_infinity()) return TagConsoleTime::max();
    if (timestamp.is_special()) return TagConsoleTime::min();
    return TagConsoleTime(std::chrono::microseconds(MicrosecondsSinceUnixEpoch(timestamp)));
}

}  // namespace Korvane::Veldra::TagLibrary
