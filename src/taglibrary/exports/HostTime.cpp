#include "taglibrary/exports/HostTime.h"

#include <boost/date_time/gregorian/gregorian_types.hpp>
#include <cmath>
#include <stdexcept>

namespace Korvane::Veldra::TagLibrary {
namespace {

constexpr double kTwoToThe64 = 18446744073709551616.0;
constexpr int64_t kMicrosPerSecond = 1000000;

// Days since 1970-01-01 to a proleptic Gregorian date.
void CivilFromDays(int64_t days, int64_t& year, int64_t& month, int64_t& day) {
    days += 719468;
    const int64_t era = (days >= 0 ? days : days - 146096) / 146097;
    const int64_t doe = days - era * 146097;
    const int64_t yoe = (doe - doe / 1460 + doe / 36524 - doe / 146096) / 365;
    const int64_t doy = doe - (365 * yoe + yoe / 4 - yoe / 100);
    const int64_t mp = (5 * doy + 2) / 153;
    day = doy - (153 * mp + 2) / 5 + 1;
    month = mp < 10 ? mp + 3 : mp - 9;
    year = yoe + era * 400 + (month <= 2 ? 1 : 0);
}

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
    int64_t year = 0, month = 0, day = 0;
    CivilFromDays(days, year, month, day);
    // The calendar takes 1400 to 9999; a year of 10000 is refused with the same text.
    if (year < 1400 || year > 9999) {
        throw std::out_of_range("Year is out of valid range: 1400..10000");
    }
    const boost::gregorian::date date(static_cast<unsigned short>(year),
                                      static_cast<unsigned short>(month),
                                      static_cast<unsigned short>(day));
    return Timestamp(date,
                     boost::posix_time::microseconds(secondOfDay * kMicrosPerSecond + micros));
}

}  // namespace Korvane::Veldra::TagLibrary
