#include <gtest/gtest.h>

#include <boost/lexical_cast.hpp>
#include <cmath>
#include <cstring>
#include <limits>

#include "taglibrary/TagTypes.h"
#include "taglibrary/ValueText.h"

using namespace Korvane::Veldra::TagLibrary;

TEST(ValueText, DoublesRoundTrip) {
    EXPECT_EQ(FormatDouble(0.1), "0.10000000000000001");
    EXPECT_EQ(FormatDouble(1.0), "1");
    EXPECT_EQ(FormatDouble(-2.5e-300), "-2.5e-300");
    const double inf = std::numeric_limits<double>::infinity();
    EXPECT_EQ(FormatDouble(inf), "Infinity");
    EXPECT_EQ(FormatDouble(-inf), "-Infinity");
    EXPECT_EQ(FormatDouble(std::nan("")), "NaN");
    for (const double value :
         {0.1, 1.0 / 3.0, -123456.789, 5e-324, 1.7976931348623157e308, inf, -inf}) {
        EXPECT_EQ(ParseDouble(FormatDouble(value)), value) << FormatDouble(value);
    }
    for (const char* text : {"NaN", ""}) {
        const double nan = ParseDouble(text);
        uint64_t bits;
        std::memcpy(&bits, &nan, sizeof bits);
        EXPECT_EQ(bits, 0x7FF8000000000000ULL) << text;
    }
}

TEST(ValueText, RefusedNumbersThrowTheCastText) {
    for (const char* text : {"abc", "1.5x", " 1", "--1"}) {
        try {
            ParseDouble(text);
            ADD_FAILURE() << text;
        } catch (const boost::bad_lexical_cast& error) {
            EXPECT_STREQ(error.what(),
                         "bad lexical cast: source type value could not be interpreted as target");
        }
    }
    EXPECT_EQ(ParseInt(""), 0);
    EXPECT_EQ(ParseInt("-42"), -42);
    EXPECT_THROW(ParseInt("2147483648"), boost::bad_lexical_cast);
    EXPECT_THROW(ParseInt("1.0"), boost::bad_lexical_cast);
}

TEST(ValueText, Booleans) {
    for (const char* text : {"true", "True", "TRUE", "1"}) EXPECT_TRUE(ParseBool(text)) << text;
    for (const char* text : {"", "tRue", "TRue", "yes", "0", "false", " true", "2"}) {
        EXPECT_FALSE(ParseBool(text)) << text;
    }
}

TEST(ValueText, PathRule) {
    EXPECT_TRUE(IsValidTagPath(" . . "));
    EXPECT_TRUE(IsValidTagPath("a/b.c d\xc3\xa9"));
    EXPECT_FALSE(IsValidTagPath(""));
    EXPECT_FALSE(IsValidTagPath("*"));
    EXPECT_FALSE(IsValidTagPath("plant.*.temp"));
}

TEST(TagTypes, Numberings) {
    EXPECT_EQ(ExportedToType(0), TagDataType::Double);
    EXPECT_EQ(ExportedToType(5), TagDataType::DateTime);
    for (const int32_t outside : {-1, 6, 9, 1000}) {
        EXPECT_EQ(ExportedToType(outside), TagDataType::None) << outside;
    }
    for (int32_t exported = 0; exported <= 5; ++exported) {
        EXPECT_EQ(TypeToExported(ExportedToType(exported)), exported);
    }
    EXPECT_EQ(TypeToExported(TagDataType::None), -1);
    EXPECT_EQ(TypeToExported(std::nullopt), -1);
    EXPECT_EQ(MessageValueToType(6), TagDataType::DateTime);
    EXPECT_EQ(MessageValueToType(0), TagDataType::None);
    EXPECT_EQ(MessageValueToType(7), TagDataType::None);

    EXPECT_EQ(TypeShortName(TagDataType::Double), "Double");
    EXPECT_EQ(TypeShortName(TagDataType::Boolean), "Boolean");
    EXPECT_EQ(TypeShortName(TagDataType::UInt64), "none");
    EXPECT_EQ(TypeShortName(TagDataType::DateTime), "none");
    EXPECT_EQ(TypeShortName(std::nullopt), "none");
}
