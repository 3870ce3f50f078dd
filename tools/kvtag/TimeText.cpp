#include "TimeText.h"

#include <cstdint>
#include <cstdio>
#include <string>

namespace kvtag {
namespace {

// Days since 1970-01-01 of a proleptic Gregorian date, and back.
int64_t DaysFromCivil(int64_t year, unsigned month, unsigned day) {
    year -= month <= 2 ? 1 : 0;
    const int64_t era = (year >= 0 ? year : year - 399) / 400;
    const auto yearOfEra = static_cast<unsigned>(year - era * 400);
    const unsigned dayOfYear = (153 * (month + (month > 2 ? -3 : 9)) + 2) / 5 + day - 1;
    const unsigned dayOfEra = yearOfEra * 365 + yearOfEra / 4 - yearOfEra / 100 + dayOfYear;
    return era * 146097 + static_cast<int64_t>(dayOfEra) - 719468;
}

struct Civil {
    int64_t year;
    unsigned month;
    unsigned day;
};

Civil CivilFromDays(int64_t days) {
    days += 719468;
    const int64_t era = (days >= 0 ? days : days - 146096) / 146097;
    const auto dayOfEra = static_cast<unsigned>(days - era * 146097);
    const unsigned yearOfEra =
        (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const unsigned dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const unsigned shifted = (5 * dayOfYear + 2) / 153;
    const unsigned day = dayOfYear - (153 * shifted + 2) / 5 + 1;
    const unsigned month = shifted < 10 ? shifted + 3 : shifted - 9;
    return {static_cast<int64_t>(yearOfEra) + era * 400 + (month <= 2 ? 1 : 0), month, day};
}

bool IsLeap(int64_t year) {
    return (year % 4 == 0 && year % 100 != 0) || year % 400 == 0;
}

unsigned DaysInMonth(int64_t year, unsigned month) {
    static constexpr unsigned kDays[] = {31, 28, 31, 30, 31, 30, 31, 31, 30, 31, 30, 31};
    return month == 2 && IsLeap(year) ? 29 : kDays[month - 1];
}

// Reads exactly `count` digits at `pos`, advancing it.
bool Digits(std::string_view text, std::size_t& pos, std::size_t count, unsigned& out) {
    if (pos + count > text.size()) return false;
    out = 0;
    for (std::size_t i = 0; i < count; ++i) {
        const char c = text[pos + i];
        if (c < '0' || c > '9') return false;
        out = out * 10 + static_cast<unsigned>(c - '0');
    }
    pos += count;
    return true;
}

bool Expect(std::string_view text, std::size_t& pos, char wanted) {
    if (pos >= text.size() || text[pos] != wanted) return false;
    ++pos;
    return true;
}

}  // namespace

std::optional<TagConsoleTime> ParseIsoTime(std::string_view text) {
    std::size_t pos = 0;
    unsigned year = 0, month = 0, day = 0, hour = 0, minute = 0, second = 0;
    if (!Digits(text, pos, 4, year) || !Expect(text, pos, '-') || !Digits(text, pos, 2, month) ||
        !Expect(text, pos, '-') || !Digits(text, pos, 2, day)) {
        return std::nullopt;
    }
    if (pos >= text.size() || (text[pos] != 'T' && text[pos] != 't')) return std::nullopt;
    ++pos;
    if (!Digits(text, pos, 2, hour) || !Expect(text, pos, ':') || !Digits(text, pos, 2, minute) ||
        !Expect(text, pos, ':') || !Digits(text, pos, 2, second)) {
        return std::nullopt;
    }
    int64_t micros = 0;
    if (pos < text.size() && text[pos] == '.') {
        ++pos;
        std::size_t count = 0;
        while (pos < text.size() && text[pos] >= '0' && text[pos] <= '9') {
            if (++count > 6) return std::nullopt;
            micros = micros * 10 + (text[pos] - '0');
            ++pos;
        }
        if (count == 0) return std::nullopt;
        for (; count < 6; ++count) micros *= 10;
    }
    int64_t offsetMinutes = 0;
    if (pos < text.size() && (text[pos] == 'Z' || text[pos] == 'z')) {
        ++pos;
    } else if (pos < text.size() && (text[pos] == '+' || text[pos] == '-')) {
        const bool negative = text[pos] == '-';
        ++pos;
        unsigned offsetHours = 0, offsetMins = 0;
        if (!Digits(text, pos, 2, offsetHours) || !Expect(text, pos, ':') ||
            !Digits(text, pos, 2, offsetMins) || offsetHours > 23 || offsetMins > 59) {
            return std::nullopt;
        }
        offsetMinutes = (negative ? -1 : 1) * static_cast<int64_t>(offsetHours * 60 + offsetMins);
    } else {
        return std::nullopt;
    }
    if (pos != text.size()) return std::nullopt;
    if (year < 1 || month < 1 || month > 12 || day < 1 || day > DaysInMonth(year, month) ||
        hour > 23 || minute > 59 || second > 59) {
        return std::nullopt;
    }
    const int64_t seconds = DaysFromCivil(year, month, day) * 86400 + hour * 3600 + minute * 60 +
                            second - offsetMinutes * 60;
    return TagConsoleTime(std::chrono::microseconds(seconds * 1000000 + micros));
}

bool LacksOnlyAZone(std::string_view text) {
    return !ParseIsoTime(text) && ParseIsoTime(std::string(text) + "Z").has_value();
}

std::string FormatIsoTime(TagConsoleTime time) {
    if (time == TagConsoleTime::min() || time == TagConsoleTime::max()) return "";
    const int64_t micros = time.time_since_epoch().count();
    const int64_t fraction = ((micros % 1000000) + 1000000) % 1000000;
    const int64_t seconds = (micros - fraction) / 1000000;
    const int64_t secondOfDay = ((seconds % 86400) + 86400) % 86400;
    const Civil date = CivilFromDays((seconds - secondOfDay) / 86400);
    char text[64];
    std::snprintf(text, sizeof text, "%04lld-%02u-%02uT%02lld:%02lld:%02lld.%06lldZ",
                  static_cast<long long>(date.year), date.month, date.day,
                  static_cast<long long>(secondOfDay / 3600),
                  static_cast<long long>(secondOfDay / 60 % 60),
                  static_cast<long long>(secondOfDay % 60), static_cast<long long>(fraction));
    return text;
}

TagConsoleTime NowTime() {
    return std::chrono::time_point_cast<std::chrono::microseconds>(
        std::chrono::system_clock::now());
}

}  // namespace kvtag
