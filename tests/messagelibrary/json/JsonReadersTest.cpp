#include <gtest/gtest.h>

#include <boost/lexical_cast.hpp>
#include <cmath>
#include <limits>
#include <string>

#include "errors/VeldraException.h"
#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonReaders.h"
#include "messagelibrary/json/JsonTestTypes.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using JsonTestTypes::Color;
using JsonTestTypes::Sample;
using MessageBus::VeldraException;

constexpr const char* kAbsent = nullptr;

// Reads member "k" of {"k":<value>}, or of {} for kAbsent.
template <typename T>
bool ReadMember(const char* value, T& out) {
    JsonVariant json;
    const std::string text = value == kAbsent ? "{}" : std::string("{\"k\":") + value + "}";
    EXPECT_TRUE(Parse(json, text)) << text;
    return ReadField(out, json, "k");
}

template <typename T>
struct Row {
    const char* value;
    bool accepted;
    T expected;
};

template <typename T>
void CheckRows(std::initializer_list<Row<T>> rows) {
    for (const Row<T>& row : rows) {
        T out{};
        const char* shown = row.value ? row.value : "(absent)";
        ASSERT_EQ(ReadMember(row.value, out), row.accepted) << shown;
        if (row.accepted) {
            EXPECT_EQ(out, row.expected) << shown;
        }
    }
}

TEST(JsonReaders, Bool) {
    CheckRows<bool>({{kAbsent, true, false},
                     {"true", true, true},
                     {"false", true, false},
                     {"null", false, false},
                     {"1", false, false},
                     {"\"true\"", false, false},
                     {"[]", false, false}});
}

TEST(JsonReaders, Int32) {
    CheckRows<int32_t>({{kAbsent, true, 0},
                        {"3.9", true, 3},
                        {"-3.9", true, -3},
                        {"\"12\"", true, 12},
                        {"\"-7\"", true, -7},
                        {"2147483647", true, 2147483647},
                        {"-2147483648", true, std::numeric_limits<int32_t>::min()},
                        {"2147483648", false, 0},
                        {"1e300", false, 0},
                        {"null", false, 0},
                        {"true", false, 0},
                        {"{}", false, 0}});
}

TEST(JsonReaders, Double) {
    CheckRows<double>({{kAbsent, true, 0.0},
                       {"1.5", true, 1.5},
                       {"\"2.25\"", true, 2.25},
                       {"\"Infinity\"", true, std::numeric_limits<double>::infinity()},
                       {"\"-Infinity\"", true, -std::numeric_limits<double>::infinity()},
                       {"null", false, 0.0},
                       {"false", false, 0.0},
                       {"[1]", false, 0.0}});
    double out = 0;
    ASSERT_TRUE(ReadMember("\"NaN\"", out));
    EXPECT_TRUE(std::isnan(out));
}

TEST(JsonReaders, UnconvertibleTextThrowsTheConversionFailure) {
    int32_t number = 0;
    EXPECT_THROW(ReadMember("\"x\"", number), boost::bad_lexical_cast);
    EXPECT_THROW(ReadMember("\"12.5\"", number), boost::bad_lexical_cast);
    double real = 0;
    EXPECT_THROW(ReadMember("\"1,5\"", real), boost::bad_lexical_cast);
    try {
        ReadMember("\"x\"", number);
    } catch (const boost::bad_lexical_cast& e) {
        EXPECT_STREQ(e.what(),
                     "bad lexical cast: source type value could not be interpreted as target");
    }
}

TEST(JsonReaders, OptionalString) {
    using S = std::optional<std::string>;
    CheckRows<S>({{kAbsent, true, S()},
                  {"null", true, S()},
                  {"\"\"", true, S("")},
                  {"\"a\\tb\"", true, S("a\tb")},
                  {"1", false, S()},
                  {"[]", false, S()}});
    // A value that was set before is cleared by an absent key.
    S out("old");
    EXPECT_TRUE(ReadMember(kAbsent, out));
    EXPECT_FALSE(out.has_value());
}

TEST(JsonReaders, Timestamps) {
    const Timestamp nadt(boost::posix_time::not_a_date_time);
    const Timestamp point(boost::gregorian::date(2016, 3, 1),
                          boost::posix_time::hours(12) + boost::posix_time::milliseconds(250));
    CheckRows<Timestamp>({{kAbsent, true, nadt},
                          {"\"2016-03-01T12:00:00.25Z\"", true, point},
                          {"\"0001-01-01T00:00:00\"", true, nadt},
                          {"null", false, nadt},
                          {"\"2016-03-01\"", false, nadt},
                          {"20160301", false, nadt}});
    using O = std::optional<Timestamp>;
    CheckRows<O>({{kAbsent, true, O()},
                  {"null", true, O()},
                  {"\"2016-03-01T12:00:00.25Z\"", true, O(point)},
                  {"\"bad\"", false, O()},
                  {"1", false, O()}});
}

TEST(JsonReaders, Enumerations) {
    using E = std::optional<Color>;
    CheckRows<E>({{kAbsent, true, E()},
                  {"null", true, E()},
                  {"\"RED\"", true, Color::Red},
                  {"\"DARK_BLUE\"", true, Color::DarkBlue},
                  {"2.7", true, Color::DarkBlue},
                  {"99", true, static_cast<Color>(99)},
                  {"-1", true, static_cast<Color>(-1)},
                  {"4294967297", true, static_cast<Color>(1)},
                  {"\"red\"", false, E()},
                  {"\"\"", false, E()},
                  {"true", false, E()},
                  {"{}", false, E()}});
}

TEST(JsonReaders, Lists) {
    using L = std::optional<JsonStringList>;
    CheckRows<L>({{kAbsent, true, L()},
                  {"null", true, L()},
                  {"[]", true, L(JsonStringList{})},
                  {"[\"a\",null,\"b\"]", true, L(JsonStringList{"a", "", "b"})},
                  {"[\"a\",1]", false, L()},
                  {"\"a\"", false, L()},
                  {"{}", false, L()}});
    using Colors = std::optional<std::vector<Color>>;
    CheckRows<Colors>({{"[\"RED\",0]", true, Colors({Color::Red, Color::None})},
                       {"[\"RED\",\"GREEN\"]", false, Colors()}});
    using Nested = std::vector<std::vector<int32_t>>;
    CheckRows<Nested>(
        {{"[[1,2],[],null]", true, Nested{{1, 2}, {}, {}}}, {"[[1,true]]", false, Nested{}}});
}

TEST(JsonReaders, NestedListWithUnconvertibleTextThrows) {
    std::vector<std::vector<int32_t>> out;
    EXPECT_THROW(ReadMember("[[1,\"x\"]]", out), boost::bad_lexical_cast);
}

TEST(JsonReaders, StringMaps) {
    using M = std::optional<JsonStringMap>;
    CheckRows<M>({{kAbsent, true, M()},
                  {"null", true, M()},
                  {"{\"b\":\"2\",\"a\":\"1\",\"n\":null}", true,
                   M(JsonStringMap{{"a", "1"}, {"b", "2"}, {"n", ""}})},
                  {"{\"a\":1}", false, M()},
                  {"[]", false, M()}});
}

TEST(JsonReaders, Records) {
    using R = std::optional<Sample>;
    Sample full;
    full.name = "n";
    full.count = 7;
    full.color = Color::Red;
    full.tags = JsonStringList{"t"};
    CheckRows<R>(
        {{kAbsent, true, R()},
         {"null", true, R()},
         {"{}", true, R(Sample{})},
         {R"({"name":"n","count":7.5,"color":"RED","tags":["t"],"extra":1})", true, R(full)},
         {R"({"count":true})", false, R()},
         {"[]", false, R()}});
}

TEST(JsonReaders, EmptyKeyReadsTheVariantItself) {
    JsonVariant json(4.0);
    int32_t out = 0;
    EXPECT_TRUE(ReadInt32(out, json, ""));
    EXPECT_EQ(out, 4);
    std::optional<std::string> text;
    EXPECT_FALSE(ReadOptionalString(text, json, ""));
}

TEST(JsonReaders, RequiredRefusesAnAbsentKey) {
    JsonVariant json;
    ASSERT_TRUE(Parse(json, R"({"a":null,"b":true})"));
    bool flag = true;
    EXPECT_FALSE(ReadBool(flag, json, "a"));
    EXPECT_TRUE(ReadBool(flag, json, "missing"));
    EXPECT_FALSE(flag);
    EXPECT_FALSE(ReadBool(flag, json, "missing", true));
    EXPECT_TRUE(ReadBool(flag, json, "b", true));
    std::optional<std::string> text;
    EXPECT_FALSE(ReadOptionalString(text, json, "missing", true));
    EXPECT_TRUE(ReadOptionalString(text, json, "a", true));
}

TEST(JsonReaders, Int64IsNotSupported) {
    int64_t out = 5;
    EXPECT_TRUE(ReadMember(kAbsent, out));
    EXPECT_EQ(out, 0);
    try {
        ReadMember("1", out);
        FAIL() << "no exception";
    } catch (const VeldraException& e) {
        EXPECT_EQ(e.Code(), -251004);
        EXPECT_STREQ(e.what(), "Int64 not supported by JsonVariant");
    }
}

// What a message's parsing constructor sees.
TEST(JsonBodyReader, RefusalThrowsWithTheCodeOfTheFieldType) {
    struct Case {
        const char* body;
        const char* key;
        int32_t code;
    };
    const Case cases[] = {
        {R"({"s":1})", "s", -251005},
        {R"({"i":null})", "i", -251005},
        {R"({"l":[1]})", "l", -251005},
        {R"({"m":{"a":[]}})", "m", -251005},
        {R"({"t":"soon"})", "t", -251005},
        {R"({"e":"PURPLE"})", "e", -251004},
        {R"({"r":{"count":"1","name":2}})", "r", -251004},
        {R"({"rl":[{"name":2}]})", "rl", -251005},
    };
    for (const Case& c : cases) {
        const JsonVariant json = ParseJsonBody(c.body, "SomeMessage");
        std::optional<std::string> s;
        int32_t i = 0;
        std::optional<JsonStringList> l;
        std::optional<JsonStringMap> m;
        Timestamp t;
        std::optional<Color> e;
        std::optional<Sample> r;
        std::optional<std::vector<Sample>> rl;
        try {
            JsonBodyReader(json)
                .Field("s", s)
                .Field("i", i)
                .Field("l", l)
                .Field("m", m)
                .Field("t", t)
                .Field("e", e)
                .Field("r", r)
                .Field("rl", rl);
            ADD_FAILURE() << c.body << " was accepted";
        } catch (const VeldraException& x) {
            EXPECT_EQ(x.Code(), c.code) << c.body;
            EXPECT_EQ(std::string(x.what()), std::string("Failed to parse: ") + c.key);
        }
    }
}

TEST(JsonBodyReader, MalformedBodyNamesTheMessage) {
    try {
        ParseJsonBody("{\"a\":", "TagInfoQueryTagsRequest");
        FAIL() << "no exception";
    } catch (const VeldraException& e) {
        EXPECT_EQ(e.Code(), -251005);
        EXPECT_STREQ(e.what(), "Failed to parse: TagInfoQueryTagsRequest");
    }
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
