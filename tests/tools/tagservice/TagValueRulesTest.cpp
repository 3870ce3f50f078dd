#include <gtest/gtest.h>

#include "TagValueRules.h"

namespace Korvane::Veldra::TagService {
namespace {

TEST(TagValueRulesTest, EachTypeReadsItsOwnTexts) {
    EXPECT_TRUE(CanReadValue(TagDataType::Double, "1.5e3"));
    EXPECT_TRUE(CanReadValue(TagDataType::Double, "NaN"));
    EXPECT_TRUE(CanReadValue(TagDataType::Double, "-Infinity"));
    EXPECT_TRUE(CanReadValue(TagDataType::Double, ""));
    EXPECT_FALSE(CanReadValue(TagDataType::Double, "1.5x"));
    EXPECT_FALSE(CanReadValue(TagDataType::Double, " 1"));

    EXPECT_TRUE(CanReadValue(TagDataType::Int, "-2147483648"));
    EXPECT_FALSE(CanReadValue(TagDataType::Int, "2147483648"));
    EXPECT_FALSE(CanReadValue(TagDataType::Int, "1.0"));

    EXPECT_TRUE(CanReadValue(TagDataType::UInt64, "18446744073709551615"));
    EXPECT_FALSE(CanReadValue(TagDataType::UInt64, "18446744073709551616"));
    EXPECT_FALSE(CanReadValue(TagDataType::UInt64, "-1"));
    EXPECT_FALSE(CanReadValue(TagDataType::UInt64, ""));
    EXPECT_FALSE(CanReadValue(TagDataType::UInt64, "+1"));

    EXPECT_TRUE(CanReadValue(TagDataType::Boolean, "TRUE"));
    EXPECT_TRUE(CanReadValue(TagDataType::Boolean, "0"));
    EXPECT_FALSE(CanReadValue(TagDataType::Boolean, "tRue"));
    EXPECT_FALSE(CanReadValue(TagDataType::Boolean, "yes"));

    EXPECT_TRUE(CanReadValue(TagDataType::DateTime, "2016-03-01T12:00:00Z"));
    EXPECT_FALSE(CanReadValue(TagDataType::DateTime, "2016-13-01T12:00:00Z"));
    EXPECT_FALSE(CanReadValue(TagDataType::DateTime, "yesterday"));

    EXPECT_TRUE(CanReadValue(TagDataType::String, std::string("\0any", 4)));
    EXPECT_FALSE(CanReadValue(TagDataType::None, "1"));
}

TEST(TagValueRulesTest, AggregatesKeepCountAverageAndTextsOfTheExtremes) {
    TagAggregates aggregates;
    for (const char* text : {"2", "-7", "11"}) AddToAggregates(aggregates, TagDataType::Int, text);
    EXPECT_EQ(aggregates.count, 3);
    EXPECT_DOUBLE_EQ(aggregates.avg, 2.0);
    EXPECT_EQ(aggregates.min, "-7");
    EXPECT_EQ(aggregates.max, "11");
}

TEST(TagValueRulesTest, DoubleExtremesAreWrittenAsDoubleTexts) {
    TagAggregates aggregates;
    AddToAggregates(aggregates, TagDataType::Double, "0.1");
    AddToAggregates(aggregates, TagDataType::Double, "1e1");
    EXPECT_EQ(aggregates.min, "0.10000000000000001");
    EXPECT_EQ(aggregates.max, "10");
}

TEST(TagValueRulesTest, UInt64ExtremesCompareExactlyBeyondDoublePrecision) {
    TagAggregates aggregates;
    AddToAggregates(aggregates, TagDataType::UInt64, "18446744073709551615");
    AddToAggregates(aggregates, TagDataType::UInt64, "18446744073709551614");
    AddToAggregates(aggregates, TagDataType::UInt64, "007");
    EXPECT_EQ(aggregates.count, 3);
    EXPECT_EQ(aggregates.min, "7");
    EXPECT_EQ(aggregates.max, "18446744073709551615");
}

TEST(TagValueRulesTest, ValuesThatAreNotFiniteStayOutOfTheAggregates) {
    TagAggregates aggregates;
    AddToAggregates(aggregates, TagDataType::Double, "NaN");
    AddToAggregates(aggregates, TagDataType::Double, "Infinity");
    AddToAggregates(aggregates, TagDataType::Double, "");
    EXPECT_EQ(aggregates.count, 0);
    AddToAggregates(aggregates, TagDataType::Double, "3");
    EXPECT_EQ(aggregates.count, 1);
    EXPECT_DOUBLE_EQ(aggregates.avg, 3.0);
}

TEST(TagValueRulesTest, OnlyNumericTypesKeepAggregates) {
    TagAggregates aggregates;
    AddToAggregates(aggregates, TagDataType::Boolean, "true");
    AddToAggregates(aggregates, TagDataType::DateTime, "2016-03-01T12:00:00Z");
    EXPECT_EQ(aggregates.count, 0);
    EXPECT_FALSE(aggregates.min);
}

}  // namespace
}  // namespace Korvane::Veldra::TagService
