#include <gtest/gtest.h>

#include <limits>
#include <map>
#include <string>

#include "messagelibrary/json/Base64.h"
#include "messagelibrary/json/JsonEscape.h"
#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonTestTypes.h"
#include "messagelibrary/json/JsonWriters.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using JsonTestTypes::Color;
using JsonTestTypes::Sample;

template <typename T>
std::string Text(const T& value) {
    JsonOutput out;
    AppendJson(out, value);
    return out.Take();
}

TEST(JsonWriters, Scalars) {
    const double inf = std::numeric_limits<double>::infinity();
    EXPECT_EQ(Text(true), "true");
    EXPECT_EQ(Text(false), "false");
    EXPECT_EQ(Text(int32_t{0}), "0");
    EXPECT_EQ(Text(std::numeric_limits<int32_t>::min()), "-2147483648");
    EXPECT_EQ(Text(int64_t{-9007199254740993}), "-9007199254740993");
    EXPECT_EQ(Text(1.5), "1.5");
    EXPECT_EQ(Text(0.1), "0.10000000000000001");
    EXPECT_EQ(Text(-0.0), "-0");
    EXPECT_EQ(Text(1e21), "1e+21");
    EXPECT_EQ(Text(123456789.0), "123456789");
    EXPECT_EQ(Text(5e-324), "4.9406564584124654e-324");
    EXPECT_EQ(Text(std::numeric_limits<double>::quiet_NaN()), "NaN");
    EXPECT_EQ(Text(inf), "Infinity");
    EXPECT_EQ(Text(-inf), "-Infinity");
}

TEST(JsonWriters, Timestamps) {
    const Timestamp point(boost::gregorian::date(2016, 3, 1),
                          boost::posix_time::hours(12) + boost::posix_time::milliseconds(250));
    EXPECT_EQ(Text(point), "\"2016-03-01T12:00:00.250000Z\"");
    EXPECT_EQ(Text(Timestamp(boost::posix_time::not_a_date_time)), "\"0001-01-01T00:00:00\"");
}

TEST(JsonWriters, StringEscaping) {
    struct Case {
        std::string text;
        const char* written;
    };
    const Case cases[] = {
        {"plain", R"("plain")"},
        {"", R"("")"},
        {"\b\t\n\f\r", R"("\b\t\n\f\r")"},
        {"\"\\/", R"("\"\\/")"},
        {std::string("\x01\x1f\x7f", 3), R"("\u0001\u001f\u007f")"},
        {"\x0b", R"("\u000b")"},
        {"\xc3\xa9\xf0\x9f\x98\x80", "\"\xc3\xa9\xf0\x9f\x98\x80\""},
        {"\xff", "\"\xff\""},
        {std::string("cut\0here", 8), R"("cut")"},
    };
    for (const Case& c : cases) EXPECT_EQ(Text(c.text), c.written) << c.text;
    // Plain bytes go in pieces of eight: an escape or an end at every place
    // of a piece and of the tail, and a text long enough to be measured first.
    for (const std::size_t size : {1, 3, 4, 5, 7, 8, 9, 16, 17, 23, 5000}) {
        for (std::size_t at = 0; at < size; at += size > 100 ? 997 : 1) {
            std::string quoted(size, 'a'), cut(size, 'b');
            quoted[at] = '"';
            cut[at] = '\0';
            EXPECT_EQ(Text(quoted), '"' + std::string(at, 'a') + "\\\"" +
                                        std::string(size - at - 1, 'a') + '"')
                << size << " " << at;
            EXPECT_EQ(Text(cut), '"' + std::string(at, 'b') + '"') << size << " " << at;
        }
    }
}

TEST(JsonWriters, EscapeReturnsTheInputWhenNothingChanges) {
    std::string storage = "untouched";
    const std::string plain = "no escapes here";
    const std::string_view same = EscapeJsonText(plain, storage);
    EXPECT_EQ(same.data(), plain.data());
    EXPECT_EQ(storage, "untouched");
    EXPECT_EQ(EscapeJsonText("a\"b", storage), "a\\\"b");
    EXPECT_EQ(JsonEscapedLength("a\x01"), 7u);
}

TEST(JsonWriters, OptionalStringsWriteNullOnlyWhenUnset) {
    EXPECT_EQ(Text(std::optional<std::string>()), "null");
    EXPECT_EQ(Text(std::optional<std::string>("")), R"("")");
    EXPECT_EQ(Text(static_cast<const char*>(nullptr)), "null");
    EXPECT_EQ(Text("literal"), R"("literal")");
}

TEST(JsonWriters, ListsMapsEnumerations) {
    EXPECT_EQ(Text(std::optional<JsonStringList>()), "null");
    EXPECT_EQ(Text(JsonStringList{}), "[]");
    EXPECT_EQ(Text(JsonStringList{"a", "b\"c"}), R"(["a","b\"c"])");
    EXPECT_EQ(Text(std::vector<std::optional<std::string>>{std::nullopt, "x"}), R"([null,"x"])");
    EXPECT_EQ(Text(std::optional<JsonStringMap>()), "null");
    EXPECT_EQ(Text(JsonStringMap{{"z\n", "1"}, {"a", ""}}), R"({"a":"","z\n":"1"})");
    EXPECT_EQ(Text(std::optional<Color>()), "null");
    EXPECT_EQ(Text(Color::DarkBlue), R"("DARK_BLUE")");
    EXPECT_EQ(Text(static_cast<Color>(99)), R"("")");
    EXPECT_EQ(Text(std::vector<Color>{Color::Red, Color::None}), R"(["RED","NONE"])");
}

TEST(JsonWriters, RecordsAndBodies) {
    Sample sample;
    sample.count = -3;
    EXPECT_EQ(Text(sample), R"({"name":null,"count":-3,"color":null,"tags":null})");
    EXPECT_EQ(Text(std::optional<Sample>()), "null");

    sample.name = "";
    sample.color = Color::Red;
    sample.tags = JsonStringList{"k"};
    const std::string body = JsonBodyWriter()
                                 .Field("samples", std::vector<Sample>{sample, Sample{}})
                                 .Field("flag", false)
                                 .Field("raw", JsonRaw{R"(["KEYWORDS", "PROPERTIES"])"})
                                 .Finish();
    EXPECT_EQ(body, R"({"samples":[{"name":"","count":-3,"color":"RED","tags":["k"]},)"
                    R"({"name":null,"count":0,"color":null,"tags":null}],"flag":false,)"
                    R"("raw":["KEYWORDS", "PROPERTIES"]})");
    EXPECT_EQ(JsonBodyWriter().Finish(), "{}");
}

TEST(JsonWriters, WrittenRecordsReadBack) {
    Sample sample;
    sample.name = "n\u00e9\x7f";
    sample.count = 12;
    sample.color = static_cast<Color>(2);
    sample.tags = JsonStringList{"", "a/b"};
    const std::string body = JsonBodyWriter().Field("s", sample).Finish();
    JsonVariant json;
    ASSERT_TRUE(Parse(json, body)) << body;
    std::optional<Sample> back;
    ASSERT_TRUE(ReadField(back, json, "s"));
    EXPECT_TRUE(*back == sample);
}

TEST(JsonWriters, BareNaNIsTheWireFormAndNotJson) {
    const std::string body =
        JsonBodyWriter().Field("d", std::numeric_limits<double>::quiet_NaN()).Finish();
    EXPECT_EQ(body, R"({"d":NaN})");
    JsonVariant json;
    EXPECT_FALSE(Parse(json, body));
}

TEST(Base64, EncodesWithPaddingAndDecodesBack) {
    struct Case {
        std::string bytes;
        const char* text;
    };
    const Case cases[] = {
        {"", ""},
        {"f", "Zg=="},
        {"fo", "Zm8="},
        {"foo", "Zm9v"},
        {"foob", "Zm9vYg=="},
        {std::string("\xff\xfe\x00", 3), "//4A"},
        {"\xfb\xff", "+/8="},
    };
    for (const Case& c : cases) {
        EXPECT_EQ(Base64Encode(c.bytes.data(), c.bytes.size()), c.text);
        std::vector<uint8_t> back;
        ASSERT_TRUE(Base64Decode(c.text, back)) << c.text;
        EXPECT_EQ(std::string(back.begin(), back.end()), c.bytes);
    }
    JsonOutput field;
    AppendJsonBase64(field, "fo", 2);
    EXPECT_EQ(field.Take(), R"("Zm8=")");
    std::vector<uint8_t> out;
    for (const char* bad : {"Zg=", "Z===", "Zg=a", "Zm8=Zm8=", "Zm9*", "=Zm9"}) {
        EXPECT_FALSE(Base64Decode(bad, out)) << bad;
    }
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
