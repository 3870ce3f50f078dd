#include <gtest/gtest.h>

#include <boost/date_time/gregorian/gregorian_types.hpp>
#include <stdexcept>

#include "taglibrary/exports/wb/HostTime.h"

using namespace Korvane::Veldra::TagLibrary;
namespace pt = boost::posix_time;
namespace gr = boost::gregorian;

TEST(HostTime, SpecialValuesGiveFixedResults) {
    const auto nadt = TimestampToHostParts(Timestamp(pt::not_a_date_time));
    EXPECT_EQ(nadt.seconds, 9225454881654LL);
    EXPECT_DOUBLE_EQ(nadt.fraction, 0.775806);
    const auto posInf = TimestampToHostParts(Timestamp(pt::pos_infin));
    EXPECT_EQ(posInf.seconds, 9225454881654LL);
    EXPECT_DOUBLE_EQ(posInf.fraction, 0.775807);
    const auto negInf = TimestampToHostParts(Timestamp(pt::neg_infin));
    EXPECT_EQ(negInf.seconds, -9221289192054LL);
    EXPECT_DOUBLE_EQ(negInf.fraction, -0.775808);
}

TEST(HostTime, RoundTripsAtMicrosecondResolution) {
    const Timestamp points[] = {
        Timestamp(gr::date(1970, 1, 1)),
        Timestamp(gr::date(1904, 1, 1)),
        Timestamp(gr::date(2016, 3, 1), pt::hours(12) + pt::microseconds(250000)),
        Timestamp(gr::date(1850, 7, 4), pt::seconds(1) + pt::microseconds(999999)),
        Timestamp(gr::date(1400, 1, 1)),
        Timestamp(gr::date(9999, 12, 31), pt::hours(23) + pt::minutes(59) + pt::seconds(59)),
    };
    for (const auto& point : points) {
        const WBTimestamp host = TimestampToHostTime(point);
        EXPECT_EQ(HostTimeToTimestamp(host), point)
            << Korvane::Veldra::VeldraMessageLibrary::TimestampToText(point);
    }
    EXPECT_EQ(TimestampToHostTime(Timestamp(gr::date(1904, 1, 1))).seconds, 0);
    EXPECT_EQ(TimestampToHostTime(Timestamp(gr::date(1970, 1, 1))).seconds, 2082844800);
}

TEST(HostTime, FractionsAndTheCalendar) {
    // A fraction a hair below one is a whole second.
    WBTimestamp almostOne{UINT64_MAX, 2082844800};
    EXPECT_EQ(HostTimeToTimestamp(almostOne), Timestamp(gr::date(1970, 1, 1), pt::seconds(1)));
    WBTimestamp half{1ULL << 63, 2082844800};
    EXPECT_EQ(HostTimeToTimestamp(half), Timestamp(gr::date(1970, 1, 1), pt::microseconds(500000)));
    // Before the host's epoch: negative seconds, a positive fraction.
    const Timestamp before(gr::date(1903, 12, 31), pt::hours(23) + pt::microseconds(1));
    EXPECT_LT(TimestampToHostTime(before).seconds, 0);
    EXPECT_EQ(HostTimeToTimestamp(TimestampToHostTime(before)), before);

    for (const int64_t seconds :
         {int64_t{-20000000000LL}, int64_t{300000000000LL}, INT64_MAX, INT64_MIN}) {
        try {
            HostTimeToTimestamp(WBTimestamp{0, seconds});
            ADD_FAILURE() << seconds;
        } catch (const std::out_of_range& error) {
            EXPECT_STREQ(error.what(), "Year is out of valid range: 1400..10000");
        }
    }
}
