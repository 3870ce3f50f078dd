#include <gtest/gtest.h>

#include "TagTypes.h"
#include "TimeText.h"
#include "ValueRules.h"

namespace kvtag {
namespace {

TEST(KvtagTypes, NamesMatchTheInterfaceCodes) {
    const char* names[] = {"double", "int32", "string", "bool", "uint64", "datetime"};
    for (int32_t code = 0; code < 6; ++code) {
        EXPECT_EQ(ParseTypeName(names[code]), code);
        EXPECT_EQ(TypeName(code), names[code]);
    }
    // The names people type, in any case.
    const std::pair<const char*, int32_t> others[] = {
        {"Double", 0},  {"float", 0}, {"int", 1},      {"INTEGER", 1}, {"text", 2},
        {"Boolean", 3}, {"uint", 4},  {"DateTime", 5}, {"time", 5},    {"timestamp", 5}};
    for (const auto& [name, code] : others) EXPECT_EQ(ParseTypeName(name), code) << name;
    EXPECT_FALSE(ParseTypeName("int64"));
    EXPECT_FALSE(ParseTypeName(""));
    EXPECT_EQ(TypeName(-1), "none");
    EXPECT_EQ(TypeName(6), "none");
}

TEST(KvtagValues, IntegersKeepToTheirRanges) {
    EXPECT_EQ(NormalizeValue(1, "2147483647"), "2147483647");
    EXPECT_EQ(NormalizeValue(1, "-2147483648"), "-2147483648");
    EXPECT_EQ(NormalizeValue(1, "+7"), "+7");
    for (const char* bad : {"2147483648", "-2147483649", "1.5", "", "-", "12a", " 1"}) {
        EXPECT_FALSE(NormalizeValue(1, bad)) << bad;
    }
    EXPECT_EQ(NormalizeValue(4, "18446744073709551615"), "18446744073709551615");
    for (const char* bad : {"18446744073709551616", "-1", "+1", "", "1e3"}) {
        EXPECT_FALSE(NormalizeValue(4, bad)) << bad;
    }
}

TEST(KvtagValues, DoublesAreWholeDecimalTexts) {
    for (const char* good : {"12.5", "-0.25", "1e-3", "7", "nan", "inf", "-inf"}) {
        EXPECT_EQ(NormalizeValue(0, good), good);
    }
    for (const char* bad : {"", "abc", "1.5x", " 1", "0x10", "1,5", "1e400", "-1e400"}) {
        EXPECT_FALSE(NormalizeValue(0, bad)) << bad;
    }
    EXPECT_EQ(ValueRefusal(0, "1e400"),
              "'1e400' is not a value of type double: it is beyond the range of a double");
    EXPECT_EQ(ValueRefusal(0, "abc"), "'abc' is not a value of type double");
}

TEST(KvtagValues, BooleansGoOutInOneSpelling) {
    EXPECT_EQ(NormalizeValue(3, "true"), "True");
    EXPECT_EQ(NormalizeValue(3, "TRUE"), "True");
    EXPECT_EQ(NormalizeValue(3, "1"), "True");
    EXPECT_EQ(NormalizeValue(3, "fAlSe"), "False");
    EXPECT_EQ(NormalizeValue(3, "0"), "False");
    for (const char* bad : {"yes", "", "2", "t"}) EXPECT_FALSE(NormalizeValue(3, bad)) << bad;
}

TEST(KvtagValues, DateTimesAndStrings) {
    EXPECT_EQ(NormalizeValue(5, "2026-03-01T09:30:00.5+01:00"), "2026-03-01T08:30:00.500000Z");
    EXPECT_FALSE(NormalizeValue(5, "2026-03-01"));
    EXPECT_EQ(ValueRefusal(5, "2026-03-01T08:30:00"),
              "'2026-03-01T08:30:00' is not a value of type datetime: it has no zone; add Z "
              "(UTC) or an offset such as +01:00");
    EXPECT_EQ(NormalizeValue(2, ""), "");
    EXPECT_EQ(NormalizeValue(2, "Ana \"night shift\"\n"), "Ana \"night shift\"\n");
    EXPECT_FALSE(NormalizeValue(2, std::string("a\0b", 3)));
    EXPECT_FALSE(NormalizeValue(-1, "1"));
    EXPECT_FALSE(NormalizeValue(6, "1"));
}

TEST(KvtagTime, ParsesZonesAndFractionsToTheMicrosecond) {
    const auto utc = ParseIsoTime("2026-03-01T08:30:00.250000Z");
    ASSERT_TRUE(utc);
    EXPECT_EQ(utc->time_since_epoch().count(), 1772353800250000LL);
    EXPECT_EQ(ParseIsoTime("2026-03-01T10:30:00.25+02:00"), utc);
    EXPECT_EQ(ParseIsoTime("2026-03-01T03:00:00.25-05:30"), utc);
    EXPECT_EQ(ParseIsoTime("2026-03-01t08:30:00.250z"), utc);
    EXPECT_EQ(FormatIsoTime(*ParseIsoTime("2026-03-01T08:30:00.000001Z")),
              "2026-03-01T08:30:00.000001Z");
}

TEST(KvtagTime, RefusesTextsThatAreNotOneInstant) {
    for (const char* bad :
         {"2026-03-01T08:30:00", "2026-03-01 08:30:00Z", "2026-03-01T08:30:00.1234567Z",
          "2026-03-01T08:30:00.Z", "2026-02-29T00:00:00Z", "2026-13-01T00:00:00Z",
          "2026-01-01T24:00:00Z", "2026-01-01T23:60:00Z", "2026-01-01T23:59:60Z",
          "0000-01-01T00:00:00Z", "2026-03-01T08:30:00Z ", "2026-03-01T08:30:00+0100",
          "2026-3-01T08:30:00Z", ""}) {
        EXPECT_FALSE(ParseIsoTime(bad)) << bad;
    }
    EXPECT_TRUE(ParseIsoTime("2024-02-29T00:00:00Z"));
    EXPECT_TRUE(ParseIsoTime("2000-02-29T00:00:00Z"));
    EXPECT_FALSE(ParseIsoTime("1900-02-29T00:00:00Z"));
}

TEST(KvtagTime, FormatsBeforeTheEpochAndTheBoundlessTimes) {
    EXPECT_EQ(FormatIsoTime(TagConsoleTime(std::chrono::microseconds(-1))),
              "1969-12-31T23:59:59.999999Z");
    EXPECT_EQ(FormatIsoTime(TagConsoleTime(std::chrono::microseconds(0))),
              "1970-01-01T00:00:00.000000Z");
    const auto early = ParseIsoTime("0001-01-01T00:00:00Z");
    ASSERT_TRUE(early);
    EXPECT_EQ(FormatIsoTime(*early), "0001-01-01T00:00:00.000000Z");
    EXPECT_EQ(FormatIsoTime(*ParseIsoTime("9999-12-31T23:59:59.999999Z")),
              "9999-12-31T23:59:59.999999Z");
    EXPECT_EQ(FormatIsoTime(TagConsoleTime::min()), "");
    EXPECT_EQ(FormatIsoTime(TagConsoleTime::max()), "");
}

}  // namespace
}  // namespace kvtag
