#include <gtest/gtest.h>

#include <limits>
#include <string>

#include "messagelibrary/json/Timestamp.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using boost::gregorian::date;
using boost::posix_time::hours;
using boost::posix_time::microseconds;
using boost::posix_time::minutes;
using boost::posix_time::seconds;

const Timestamp kNotADateTime(boost::posix_time::not_a_date_time);
const Timestamp kPosInfinity(boost::posix_time::pos_infin);
const Timestamp kNegInfinity(boost::posix_time::neg_infin);

TEST(Timestamp, WritesTheTextForms) {
    struct Case {
        Timestamp point;
        const char* text;
    };
    const Case cases[] = {
        {Timestamp(date(2016, 3, 1), hours(12) + microseconds(250000)),
         "2016-03-01T12:00:00.250000Z"},
        {Timestamp(date(2016, 3, 1), hours(12)), "2016-03-01T12:00:00Z"},
        {Timestamp(date(1969, 12, 31), hours(23) + minutes(59) + seconds(59) + microseconds(1)),
         "1969-12-31T23:59:59.000001Z"},
        {Timestamp(date(1400, 1, 1)), "1400-01-01T00:00:00Z"},
        {Timestamp(date(9999, 12, 31),
                   hours(23) + minutes(59) + seconds(59) + microseconds(999999)),
         "9999-12-31T23:59:59.999999Z"},
        {kNotADateTime, "0001-01-01T00:00:00"},
        {kNegInfinity, "0001-01-01T00:00:00"},
        {kPosInfinity, "9999-12-31T23:59:59.9999999"},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(TimestampToText(c.point), c.text);
        std::string appended = "x";
        AppendTimestampText(c.point, appended);
        EXPECT_EQ(appended, std::string("x") + c.text);
    }
}

TEST(Timestamp, ReadsTheTextForms) {
    struct Case {
        const char* text;
        Timestamp expected;
    };
    const Timestamp midnight(date(2016, 1, 1));
    const Case cases[] = {
        {"2016-01-01T00:00:00Z", midnight},
        {"2016-01-01T00:00:00", midnight},
        {"20160101T000000", midnight},
        {"2016-03-01T12:00:00.25Z", Timestamp(date(2016, 3, 1), hours(12) + microseconds(250000))},
        {"2016-03-01T12:00:00.250000Z",
         Timestamp(date(2016, 3, 1), hours(12) + microseconds(250000))},
        {"2016-03-01T12:00:00.1234567899",
         Timestamp(date(2016, 3, 1), hours(12) + microseconds(123456))},
        {"20160301T12", Timestamp(date(2016, 3, 1), hours(12))},
        {"2016-01-01T25:00:00Z", Timestamp(date(2016, 1, 2), hours(1))},
        {"2016-02-29T00:00:00Z", Timestamp(date(2016, 2, 29))},
        // No zones: the offset stands where the fraction is expected.
        {"2016-01-01T00:00:00+01:00", midnight + microseconds(10000)},
        {"2016-01-01T00:00:00-05:00", midnight + microseconds(500000)},
        // Not mapped back to +infinity.
        {"9999-12-31T23:59:59.9999999",
         Timestamp(date(9999, 12, 31),
                   hours(23) + minutes(59) + seconds(59) + microseconds(999999))},
        {"0001-01-01T00:00:00", kNotADateTime},
        {"0001-01-01T00:00:00Z", kNotADateTime},
    };
    for (const Case& c : cases) {
        Timestamp result;
        ASSERT_TRUE(ParseTimestamp(c.text, result)) << c.text;
        EXPECT_EQ(result, c.expected) << c.text;
    }
}

TEST(Timestamp, RefusesAndLeavesTheResultUnchanged) {
    const char* refused[] = {
        "2016-01-01",            // no "T"
        "2016-01-01T",           // empty time part
        "2016-13-01T00:00:00Z",  // month
        "2016-02-30T00:00:00Z",  // day
        "2015-02-29T00:00:00Z",  // not a leap year
        "1399-12-31T00:00:00Z",  // before the calendar
        "2016-3-1T00:00:00",     // no leading zeros: cut at the wrong places
        "2016-01-01T0a:00:00",   // not a number
        "2016-01-01T00:00:00.+1",
        "9999-12-31T24:00:00",  // rolls beyond the calendar
        "",
        "T",
    };
    const Timestamp before(date(2000, 1, 1));
    for (const char* text : refused) {
        Timestamp result = before;
        EXPECT_FALSE(ParseTimestamp(text, result)) << text;
        EXPECT_EQ(result, before) << text;
    }
}

TEST(Timestamp, ZeroTerminatedFormHasNoSpecialShortcut) {
    Timestamp result;
    EXPECT_TRUE(ParseTimestampZ("2016-01-01T00:00:00Z", result));
    EXPECT_EQ(result, Timestamp(date(2016, 1, 1)));
    EXPECT_FALSE(ParseTimestampZ("0001-01-01T00:00:00", result));
    EXPECT_FALSE(ParseTimestampZ(nullptr, result));
}

TEST(Timestamp, WrittenPointsReadBack) {
    const Timestamp points[] = {
        Timestamp(date(2016, 3, 1), hours(12) + microseconds(1)),
        Timestamp(date(1400, 1, 1)),
        Timestamp(date(1901, 7, 4), hours(3) + minutes(2) + seconds(1) + microseconds(999999)),
        kNotADateTime,
    };
    for (const Timestamp& point : points) {
        Timestamp back;
        ASSERT_TRUE(ParseTimestamp(TimestampToText(point), back)) << TimestampToText(point);
        EXPECT_EQ(back, point);
    }
    // Across the whole calendar, leap days and century years among them.
    for (date day(1400, 1, 1); day < date(9999, 12, 31); day += boost::gregorian::days(13)) {
        const Timestamp point(day, hours(23) + microseconds(7));
        Timestamp back;
        ASSERT_TRUE(ParseTimestamp(TimestampToText(point), back)) << TimestampToText(point);
        ASSERT_EQ(back, point) << TimestampToText(point);
    }
}

TEST(Timestamp, Ticks) {
    const Timestamp epoch(date(1970, 1, 1));
    EXPECT_EQ(TimestampToTicks(epoch), kUnixEpochTicks);
    EXPECT_EQ(TimestampToTicks(epoch + microseconds(1)), kUnixEpochTicks + 1);
    EXPECT_EQ(TimestampToTicks(kNotADateTime), kNotADateTimeTicks);
    EXPECT_EQ(TimestampToTicks(kPosInfinity), kPosInfinityTicks);
    EXPECT_EQ(TimestampToTicks(kNegInfinity), kNegInfinityTicks);
    EXPECT_TRUE(TimestampFromTicks(kNotADateTimeTicks).is_not_a_date_time());
    EXPECT_TRUE(TimestampFromTicks(kPosInfinityTicks).is_pos_infinity());
    EXPECT_TRUE(TimestampFromTicks(kNegInfinityTicks).is_neg_infinity());
    const Timestamp point(date(2016, 3, 1), hours(12) + microseconds(7));
    EXPECT_EQ(TimestampFromTicks(TimestampToTicks(point)), point);
    // Counts outside the calendar saturate instead of giving a date with no text.
    EXPECT_TRUE(TimestampFromTicks(0).is_neg_infinity());
    EXPECT_TRUE(TimestampFromTicks(kNotADateTimeTicks - 1).is_pos_infinity());
    EXPECT_EQ(MicrosecondsSinceUnixEpoch(epoch - seconds(1)), -1000000);
    EXPECT_EQ(MicrosecondsSinceUnixEpoch(kNotADateTime), kNotADateTimeTicks);
}

TEST(Timestamp, FromUnixSeconds) {
    EXPECT_EQ(TimestampFromUnixSeconds(0), Timestamp(date(1970, 1, 1)));
    EXPECT_EQ(TimestampFromUnixSeconds(1456833600), Timestamp(date(2016, 3, 1), hours(12)));
    EXPECT_EQ(TimestampFromUnixSeconds(-86400), Timestamp(date(1969, 12, 31)));
    EXPECT_TRUE(TimestampFromUnixSeconds(std::numeric_limits<int64_t>::max()).is_pos_infinity());
    EXPECT_TRUE(TimestampFromUnixSeconds(std::numeric_limits<int64_t>::min()).is_neg_infinity());
    EXPECT_TRUE(TimestampFromUnixSeconds(1000000000000LL).is_pos_infinity());
    EXPECT_EQ(TimestampToText(TimestampFromUnixSeconds(-1000000000000LL)), "0001-01-01T00:00:00");
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
