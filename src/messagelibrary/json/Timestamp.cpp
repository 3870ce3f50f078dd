#include "messagelibrary/json/Timestamp.h"

#include <boost/date_time/gregorian/gregorian_types.hpp>
#include <algorithm>
#include <cstring>
#include <limits>
#include <string>
#include <string_view>

#include "messagelibrary/json/CivilDate.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using boost::posix_time::ptime;

constexpr int64_t kMicrosPerSecond = 1000000;
constexpr int64_t kMicrosPerDay = 86400LL * kMicrosPerSecond;

const ptime& UnixEpoch() {
    static const ptime epoch(boost::gregorian::date(1970, 1, 1));
    return epoch;
}

// The calendar's range: 1400-01-01T00:00:00 to 9999-12-31T23:59:59.999999,
// in microseconds since 1970. Points outside it have no date text.
constexpr int64_t kFirstMicros = -17987443200LL * kMicrosPerSecond;
constexpr int64_t kLastMicros = 253402300800LL * kMicrosPerSecond - 1;

// Writes value in width digits, zero-padded, and returns the position behind them.
char* PutDigits(char* at, int64_t value, int width) {
    for (int position = width; position > 0;) {
        at[--position] = static_cast<char>('0' + value % 10);
        value /= 10;
    }
    return at + width;
}

char* PutSeparated(char* at, char separator, int64_t value) {
    *at = separator;
    return PutDigits(at + 1, value, 2);
}

// Parses a piece of decimal digits; an empty piece is 0.
bool ParseDigits(std::string_view text, std::size_t from, std::size_t length, int64_t& value) {
    value = 0;
    if (from >= text.size()) return true;
    const std::size_t end = std::min(text.size(), from + length);
    for (std::size_t i = from; i < end; ++i) {
        const char c = text[i];
        if (c < '0' || c > '9') return false;
        value = value * 10 + (c - '0');
    }
    return true;
}

// The pieces of a time's text, as read.
struct TimeFields {
    int64_t year = 0, month = 0, day = 0;
    int64_t hours = 0, minutes = 0, seconds = 0, fraction = 0;
};

// Reads the text without its separators (every ":", "-" and "Z" dropped),
// cut at fixed places: any form the calendar's own reader takes.
bool ReadStripped(const char* text, std::size_t length, TimeFields& f) {
    // In place for any text a timestamp can be; longer ones take the heap.
    char local[64];
    std::string longer;
    char* kept = local;
    if (length > sizeof(local)) {
        longer.resize(length);
        kept = longer.data();
    }
    std::size_t size = 0;
    for (std::size_t i = 0; i < length; ++i) {
        const char c = text[i];
        if (c != ':' && c != '-' && c != 'Z') kept[size++] = c;
    }
    const std::string_view stripped(kept, size);
    const auto t = stripped.find('T');
    if (t == std::string_view::npos) return false;
    const std::string_view datePart = stripped.substr(0, t);
    const std::string_view timePart = stripped.substr(t + 1);
    if (timePart.empty()) return false;
    if (!ParseDigits(datePart, 0, 4, f.year) || !ParseDigits(datePart, 4, 2, f.month) ||
        !ParseDigits(datePart, 6, 2, f.day) || !ParseDigits(timePart, 0, 2, f.hours) ||
        !ParseDigits(timePart, 2, 2, f.minutes) || !ParseDigits(timePart, 4, 2, f.seconds)) {
        return false;
    }
    // The last piece: up to 7 characters, the first meant to be the ".".
    if (timePart.size() > 7) {
        const std::string_view digits = timePart.substr(7, 6);
        if (!ParseDigits(digits, 0, digits.size(), f.fraction)) return false;
        for (std::size_t n = digits.size(); n < 6; ++n) f.fraction *= 10;
    }
    return true;
}

// Reads the form this library writes, "YYYY-MM-DDTHH:MM:SS", then "." and
// digits, then "Z", the last two optional, at its fixed places. For such a
// text the result is what ReadStripped gives; any other text is refused here
// and left to it.
bool ReadWireForm(const char* t, std::size_t length, TimeFields& f) {
    if (length < 19 || t[4] != '-' || t[7] != '-' || t[10] != 'T' || t[13] != ':' ||
        t[16] != ':') {
        return false;
    }
    const std::string_view text(t, length);
    if (!ParseDigits(text, 0, 4, f.year) || !ParseDigits(text, 5, 2, f.month) ||
        !ParseDigits(text, 8, 2, f.day) || !ParseDigits(text, 11, 2, f.hours) ||
        !ParseDigits(text, 14, 2, f.minutes) || !ParseDigits(text, 17, 2, f.seconds)) {
        return false;
    }
    std::size_t i = 19;
    f.fraction = 0;
    if (i < length && t[i] == '.') {
        const std::size_t first = ++i;
        while (i < length && t[i] >= '0' && t[i] <= '9') ++i;
        const std::size_t used = std::min<std::size_t>(i - first, 6);
        if (used == 0) return false;
        ParseDigits(text, first, used, f.fraction);
        for (std::size_t n = used; n < 6; ++n) f.fraction *= 10;
    }
    if (i < length && t[i] == 'Z') ++i;
    return i == length;
}

// The written form first, any other form the calendar's reader takes next.
bool ParseTimeText(const char* text, std::size_t length, Timestamp& result) {
    TimeFields f;
    if (!ReadWireForm(text, length, f)) {
        f = TimeFields();
        if (!ReadStripped(text, length, f)) return false;
    }
    if (f.year < 1400 || f.year > 9999 || f.month < 1 || f.month > 12 || f.day < 1) return false;
    if (f.day > boost::gregorian::gregorian_calendar::end_of_month_day(
                    static_cast<unsigned short>(f.year), static_cast<unsigned short>(f.month))) {
        return false;
    }
    // The date is valid by now: its day number and the time of day give the
    // point, as the calendar's own types would, without their checks again.
    const int64_t micros =
        DaysFromCivil(f.year, static_cast<unsigned>(f.month), static_cast<unsigned>(f.day)) *
            kMicrosPerDay +
        ((f.hours * 60 + f.minutes) * 60 + f.seconds) * kMicrosPerSecond + f.fraction;
    // Hours that roll beyond the last day of 9999 leave the calendar.
    if (micros > kLastMicros) return false;
    result = UnixEpoch() + boost::posix_time::microseconds(micros);
    return true;
}

}  // namespace

int64_t MicrosecondsSinceUnixEpoch(const Timestamp& timestamp) {
    if (timestamp.is_not_a_date_time()) return kNotADateTimeTicks;
    if (timestamp.is_pos_infinity()) return kPosInfinityTicks;
    if (timestamp.is_neg_infinity()) return kNegInfinityTicks;
    return (timestamp - UnixEpoch()).total_microseconds();
}

int64_t TimestampToTicks(const Timestamp& timestamp) {
    if (timestamp.is_special()) return MicrosecondsSinceUnixEpoch(timestamp);
    return MicrosecondsSinceUnixEpoch(timestamp) + kUnixEpochTicks;
}

Timestamp TimestampFromTicks(int64_t ticks) {
    switch (ticks) {
        case kNotADateTimeTicks:
            return Timestamp(boost::posix_time::not_a_date_time);
        case kPosInfinityTicks:
            return Timestamp(boost::posix_time::pos_infin);
        case kNegInfinityTicks:
            return Timestamp(boost::posix_time::neg_infin);
        default:
            break;
    }
    // Counts before or beyond the calendar saturate to the infinities.
    if (ticks < kFirstMicros + kUnixEpochTicks) return Timestamp(boost::posix_time::neg_infin);
    if (ticks > kLastMicros + kUnixEpochTicks) return Timestamp(boost::posix_time::pos_infin);
    return UnixEpoch() + boost::posix_time::microseconds(ticks - kUnixEpochTicks);
}

Timestamp TimestampFromUnixSeconds(int64_t seconds) {
    constexpr int64_t kLimit =
        (std::numeric_limits<int64_t>::max() - kUnixEpochTicks) / kMicrosPerSecond;
    if (seconds > kLimit) return Timestamp(boost::posix_time::pos_infin);
    if (seconds < kFirstMicros / kMicrosPerSecond) return Timestamp(boost::posix_time::neg_infin);
    const int64_t ticks = seconds * kMicrosPerSecond + kUnixEpochTicks;
    return TimestampFromTicks(ticks);
}

char* WriteTimestampText(const Timestamp& timestamp, char* out) {
    const auto put = [out](const char* text) {
        const std::size_t size = std::strlen(text);
        std::memcpy(out, text, size);
        return out + size;
    };
    if (timestamp.is_not_a_date_time() || timestamp.is_neg_infinity()) {
        return put("0001-01-01T00:00:00");
    }
    if (timestamp.is_pos_infinity()) return put("9999-12-31T23:59:59.9999999");
    const int64_t micros = MicrosecondsSinceUnixEpoch(timestamp);
    int64_t days = micros / kMicrosPerDay;
    int64_t rest = micros % kMicrosPerDay;
    if (rest < 0) {
        rest += kMicrosPerDay;
        --days;
    }
    const CivilDate date = CivilFromDays(days);
    const int64_t secondsOfDay = rest / kMicrosPerSecond;
    const int64_t fraction = rest % kMicrosPerSecond;

    // "YYYY-MM-DDThh:mm:ss[.ffffff]Z"
    char* at = PutDigits(out, date.year, 4);
    at = PutSeparated(at, '-', date.month);
    at = PutSeparated(at, '-', date.day);
    at = PutSeparated(at, 'T', secondsOfDay / 3600);
    at = PutSeparated(at, ':', secondsOfDay / 60 % 60);
    at = PutSeparated(at, ':', secondsOfDay % 60);
    if (fraction != 0) {
        *at++ = '.';
        at = PutDigits(at, fraction, 6);
    }
    *at++ = 'Z';
    return at;
}

void AppendTimestampText(const Timestamp& timestamp, std::string& out) {
    char text[kTimestampTextMax];
    out.append(text, WriteTimestampText(timestamp, text));
}

std::string TimestampToText(const Timestamp& timestamp) {
    std::string text;
    text.reserve(28);
    AppendTimestampText(timestamp, text);
    return text;
}

bool ParseTimestamp(std::string_view text, Timestamp& result) {
    if (text == "0001-01-01T00:00:00" || text == "0001-01-01T00:00:00Z") {
        result = Timestamp(boost::posix_time::not_a_date_time);
        return true;
    }
    return ParseTimeText(text.data(), text.size(), result);
}

bool ParseTimestampZ(const char* text, Timestamp& result) {
    if (text == nullptr) return false;
    return ParseTimeText(text, std::strlen(text), result);
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
