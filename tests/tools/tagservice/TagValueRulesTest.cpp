#include <gtest/gtest.h>

#include <initializer_list>

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

    EXPECT_TRUE(CanReadValue(TagDataType::String, "any text \xc3\xa9"));
    EXPECT_FALSE(CanReadValue(TagDataType::String, std::string("a\0b", 3)));
    EXPECT_FALSE(CanReadValue(TagDataType::None, "1"));
}

// The aggregates after the texts, one after the other.
TagAggregates Fold(TagDataType type, std::initializer_list<const char*> texts) {
    TagAggregates aggregates;
    for (const char* text : texts) AddToAggregates(aggregates, type, text);
    return aggregates;
}

TEST(TagValueRulesTest, AggregatesKeepCountAverageAndTextsOfTheExtremes) {
    const TagAggregates ints = Fold(TagDataType::Int, {"2", "-7", "11"});
    EXPECT_EQ(ints.count, 3);
    EXPECT_DOUBLE_EQ(ints.avg, 2.0);
    EXPECT_EQ(ints.min, "-7");
    EXPECT_EQ(ints.max, "11");

    // Extremes are value texts of the type: a double's 17 digits.
    const TagAggregates doubles = Fold(TagDataType::Double, {"0.1", "1e1"});
    EXPECT_EQ(doubles.min, "0.10000000000000001");
    EXPECT_EQ(doubles.max, "10");

    // UInt64 compares exactly, beyond the precision of a double.
    const TagAggregates big =
        Fold(TagDataType::UInt64, {"18446744073709551615", "18446744073709551614", "007"});
    EXPECT_EQ(big.count, 3);
    EXPECT_EQ(big.min, "7");
    EXPECT_EQ(big.max, "18446744073709551615");

    // The average of extremes stays finite.
    EXPECT_DOUBLE_EQ(Fold(TagDataType::Double, {"1.7e308", "1.7e308"}).avg, 1.7e308);
}

TEST(TagValueRulesTest, ValuesThatAreNotFiniteStayOutOfTheAggregates) {
    EXPECT_EQ(Fold(TagDataType::Double, {"NaN", "Infinity", ""}).count, 0);
    const TagAggregates mixed = Fold(TagDataType::Double, {"NaN", "3", "-Infinity"});
    EXPECT_EQ(mixed.count, 1);
    EXPECT_DOUBLE_EQ(mixed.avg, 3.0);
}

TEST(TagValueRulesTest, OnlyNumericTypesKeepAggregates) {
    EXPECT_EQ(Fold(TagDataType::Boolean, {"true"}).count, 0);
    EXPECT_FALSE(Fold(TagDataType::DateTime, {"2016-03-01T12:00:00Z"}).min);
}

}  // namespace
}  // namespace Korvane::Veldra::TagService
