#include <gtest/gtest.h>

#include <clocale>
#include <cmath>
#include <limits>
#include <string>

#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonVariantText.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

JsonVariant MustParse(const std::string& text) {
    JsonVariant json;
    EXPECT_TRUE(Parse(json, text)) << text;
    return json;
}

TEST(JsonParser, BuildsTheTree) {
    const JsonVariant json =
        MustParse(R"( {"b":[1,-2.5e1,true,null,"x"],"a":{"c":"\u00e9\n"},"e":false,"d":""} )");
    ASSERT_TRUE(json.IsObject());
    ASSERT_EQ(json.Size(), 4u);
    // Members come out sorted, whatever order the text had.
    const char* order[] = {"a", "b", "d", "e"};
    std::size_t i = 0;
    for (const JsonMember& member : json.Members()) EXPECT_EQ(member.key, order[i++]);

    const JsonVariant* b = json.Find("b");
    ASSERT_NE(b, nullptr);
    ASSERT_EQ(b->Size(), 5u);
    EXPECT_EQ(b->At(0)->AsNumber(), 1.0);
    EXPECT_EQ(b->At(1)->AsNumber(), -25.0);
    EXPECT_TRUE(b->At(2)->AsBool());
    EXPECT_TRUE(b->At(3)->IsNull());
    EXPECT_EQ(b->At(4)->AsText(), "x");
    EXPECT_EQ(json.Find("a")->GetStringPointer("c"), std::string("\xc3\xa9\n"));
    EXPECT_TRUE(json.Find("d")->IsString());
    EXPECT_EQ(json.Find("d")->Size(), 0u);
    EXPECT_FALSE(json.Find("e")->AsBool());
    EXPECT_TRUE(json.Find("e")->IsBool());
}

TEST(JsonParser, RepeatedKeyKeepsTheLastValue) {
    const JsonVariant json = MustParse(R"({"k":1,"z":0,"k":[2],"k":"last"})");
    EXPECT_EQ(json.Size(), 2u);
    EXPECT_EQ(json.Find("k")->AsText(), "last");
}

TEST(JsonParser, KeysAreUnescaped) {
    const JsonVariant json = MustParse(R"({"a\"b":1,"\u0041":2})");
    EXPECT_NE(json.Find("a\"b"), nullptr);
    EXPECT_NE(json.Find("A"), nullptr);
}

TEST(JsonParser, BrokenSurrogateGivesAnEmptyStringNotAFailure) {
    const JsonVariant json = MustParse(R"(["ok","x\ud800y"])");
    EXPECT_EQ(json.At(0)->AsText(), "ok");
    EXPECT_TRUE(json.At(1)->IsString());
    EXPECT_EQ(json.At(1)->AsText(), "");
}

TEST(JsonParser, Numbers) {
    struct Case {
        const char* text;
        double value;
    };
    const Case cases[] = {
        {"0", 0.0},
        {"-0", -0.0},
        {"007", 7.0},
        {"1.", 1.0},
        {"1.25", 1.25},
        {"-1.5E-2", -0.015},
        {"1e308", 1e308},
        {"1e999", std::numeric_limits<double>::infinity()},
        {"-1e999", -std::numeric_limits<double>::infinity()},
        {"1e-999", 0.0},
        {"9007199254740993", 9007199254740992.0},
        {"0.1", 0.1},
        {"4.9406564584124654e-324", 4.9406564584124654e-324},
    };
    for (const Case& c : cases) {
        JsonVariant json;
        ASSERT_TRUE(Parse(json, c.text)) << c.text;
        EXPECT_EQ(json.AsNumber(), c.value) << c.text;
    }
}

TEST(JsonParser, RefusesWhatHasNoValue) {
    const char* refused[] = {
        "-",   "[-]",      "1e+",     "-e5",         "",        "[1,]",  "{\"a\":1,}",
        "NaN", "Infinity", "[1] [2]", "{\"a\":NaN}", "\"\\x\"", nullptr,
    };
    for (const char* text : refused) {
        JsonVariant json(JsonKind::Object);
        EXPECT_FALSE(Parse(json, text)) << (text ? text : "(null)");
        EXPECT_TRUE(json.IsNone());
    }
}

TEST(JsonParser, TextStopsAtItsFirstZeroByte) {
    const std::string text("[1]\0garbage", 11);
    JsonVariant json;
    EXPECT_TRUE(Parse(json, text));
}

TEST(JsonParser, NumbersIgnoreTheProcessLocale) {
    const char* previous = std::setlocale(LC_NUMERIC, nullptr);
    const std::string saved = previous ? previous : "C";
    const char* locales[] = {"de_DE.UTF-8", "de_DE.utf8", "fr_FR.UTF-8", "de_DE"};
    bool switched = false;
    for (const char* name : locales) {
        if (std::setlocale(LC_NUMERIC, name) != nullptr) {
            switched = true;
            break;
        }
    }
    if (!switched) GTEST_SKIP() << "no locale with a decimal comma installed";
    JsonVariant json;
    const bool parsed = Parse(json, "[1.5,2e-1]");
    const std::string text = ToJsonText(json);
    std::setlocale(LC_NUMERIC, saved.c_str());
    ASSERT_TRUE(parsed);
    EXPECT_EQ(json.At(0)->AsNumber(), 1.5);
    EXPECT_EQ(json.At(1)->AsNumber(), 0.2);
    EXPECT_EQ(text, "[1.5,0.2000000000000000111]");
}

TEST(JsonVariantText, WritesSortedCompactText) {
    const JsonVariant json = MustParse(
        R"({ "z" : [ 1 , 2.5 , -3 , 1e20, 1e300 ] , "a" : { "y" : null , "x" : true } ,
             "m" : "q\"\u007f\/" , "e" : [ ] , "o" : { } })");
    EXPECT_EQ(ToJsonText(json), R"({"a":{"x":true,"y":null},"e":[],"m":"q\"\u007f/","o":{},)"
                                R"("z":[1,2.5,-3,1e+20,1.0000000000000000525e+300]})");
}

TEST(JsonVariantText, Scalars) {
    EXPECT_EQ(ToJsonText(JsonVariant()), "");
    EXPECT_EQ(ToJsonText(JsonVariant(JsonKind::Null)), "null");
    EXPECT_EQ(ToJsonText(JsonVariant(false)), "false");
    EXPECT_EQ(ToJsonText(JsonVariant(-42.0)), "-42");
    EXPECT_EQ(ToJsonText(JsonVariant(0.5)), "0.5");
    EXPECT_EQ(ToJsonText(JsonVariant("tab\there")), "\"tab\\there\"");
}

TEST(JsonVariantText, RoundTripsThroughParse) {
    const char* documents[] = {
        R"({"a":[1,2,{"b":"c\u0001"}],"d":-0.125,"e":"\ud83d\ude00","f":[[],[{}]]})",
        R"([0.1,1e-7,123456789012345680000,-1.7976931348623157e308,5e-324])",
        R"("just a string")",
    };
    for (const char* text : documents) {
        const JsonVariant first = MustParse(text);
        const std::string written = ToJsonText(first);
        const JsonVariant second = MustParse(written);
        EXPECT_TRUE(first == second) << text << " -> " << written;
        EXPECT_EQ(ToJsonText(second), written);
    }
}

TEST(JsonVariantText, GrowsFromSmallBuffersToLargeDocuments) {
    JsonVariant json;
    for (int i = 0; i < 2000; ++i) {
        json.GetOrAddArray("list").Append(std::string(i % 50, 'x'));
    }
    const std::string text = ToJsonText(json);
    JsonVariant back;
    ASSERT_TRUE(Parse(back, text));
    EXPECT_TRUE(back == json);
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
