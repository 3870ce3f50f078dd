#include "taglibrary/exports/wb/HostTime.h"

#include <boost/date_time/gregorian/gregorian_types.hpp>
#include <cmath>
#include <stdexcept>

#include "messagelibrary/json/CivilDate.h"

namespace Korvane::Veldra::TagLibrary {
namespace {

constexpr double kTwoToThe64 = 18446744073709551616.0;
constexpr int64_t kMicrosPerSecond = 1000000;

int64_t FloorDiv(int64_t a, int64_t b) {
    const int64_t q = a / b;
    return (a % b != 0 && (a < 0) != (b < 0)) ? q - 1 : q;
}

}  // namespace

HostTimeParts TimestampToHostParts(const Timestamp& timestamp) {
    const int64_t micros = VeldraMessageLibrary::MicrosecondsSinceUnixEpoch(timestamp);
    const int64_t whole = micros / kMicrosPerSecond;  // truncates toward zero
    const int64_t rest = micros % kMicrosPerSecond;   // carries the sign of micros
    return {whole + kHostEpochOffsetSeconds, static_cast<double>(rest) / kMicrosPerSecond};
}

WBTimestamp PackHostTime(const HostTimeParts& parts) {
    int64_t seconds = parts.seconds;
    double fraction = parts.fraction;
    if (fraction < 0) {  // the host's fraction is never negative: borrow a second
        seconds -= 1;
        fraction += 1.0;
    }
    WBTimestamp result;
    result.seconds = seconds;
    result.fraction = fraction <= 0 ? 0 : static_cast<uint64_t>(std::ldexp(fraction, 64));
    return result;
}

WBTimestamp TimestampToHostTime(const Timestamp& timestamp) {
    return PackHostTime(TimestampToHostParts(timestamp));
}

Timestamp HostTimeToTimestamp(const WBTimestamp& hostTime) {
    int64_t seconds = hostTime.seconds;
    const double fraction = static_cast<double>(hostTime.fraction) / kTwoToThe64;
    int64_t micros = 0;
    if (std::fabs(1.0 - fraction) <= 2.220446049250313e-16) {
        seconds += 1;  // a fraction that is one second within rounding is a whole second
    } else {
        micros = static_cast<int64_t>(std::llround(fraction * kMicrosPerSecond));
        if (micros >= kMicrosPerSecond) {
            micros -= kMicrosPerSecond;
            seconds += 1;
        }
    }
    // Far outside the calendar either way; keep the arithmetic below in range.
    if (seconds > INT64_MAX / 2 || seconds < INT64_MIN / 2) {
        throw std::out_of_range("Year is out of valid range: 1400..10000");
    }
    const int64_t unixSeconds = seconds - kHostEpochOffsetSeconds;
    const int64_t days = FloorDiv(unixSeconds, 86400);
    const int64_t secondOfDay = unixSeconds - days * 86400;
    const VeldraMessageLibrary::CivilDate civil = VeldraMessageLibrary::CivilFromDays(days);
    // The calendar takes 1400 to 9999; a year of 10000 is refused with the same text.
    if (civil.year < 1400 || civil.year > 9999) {
        throw std::out_of_range("Year is out of valid range: 1400..10000");
    }
    const boost::gregorian::date date(static_cast<unsigned short>(civil.year),
                                      static_cast<unsigned short>(civil.month),
                                      static_cast<unsigned short>(civil.day));
    return Timestamp(date,
                     boost::posix_time::microseconds(secondOfDay * kMicrosPerSecond + micros));
}

}  // namespace Korvane::Veldra::TagLibrary
