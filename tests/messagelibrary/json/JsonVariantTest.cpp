#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <new>
#include <string>

#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonVariant.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

JsonVariant MustParse(const std::string& text) {
    JsonVariant json;
    EXPECT_TRUE(Parse(json, text)) << text;
    return json;
}

TEST(JsonVariant, KindConstructorBuildsEmptyValues) {
    EXPECT_TRUE(JsonVariant(JsonKind::None).IsNone());
    EXPECT_TRUE(JsonVariant(JsonKind::Null).IsNull());
    EXPECT_FALSE(JsonVariant(JsonKind::Boolean).AsBool());
    EXPECT_EQ(JsonVariant(JsonKind::Number).AsNumber(), 0.0);
    EXPECT_TRUE(JsonVariant(JsonKind::String).IsString());
    EXPECT_EQ(JsonVariant(JsonKind::String).AsCString(), std::string());
    EXPECT_EQ(JsonVariant(JsonKind::Array).Size(), 0u);
    EXPECT_TRUE(JsonVariant(JsonKind::Object).IsObject());
    EXPECT_THROW(JsonVariant(static_cast<JsonKind>(7)), std::bad_alloc);
    EXPECT_THROW(JsonVariant(static_cast<JsonKind>(-1)), std::bad_alloc);
}

TEST(JsonVariant, AccessorsGiveDefaultsOnOtherKinds) {
    const JsonVariant text("1");
    EXPECT_EQ(text.AsNumber(), 0.0);
    EXPECT_FALSE(text.AsBool());
    EXPECT_EQ(text.Find("a"), nullptr);
    EXPECT_EQ(text.At(0), nullptr);
    EXPECT_TRUE(text.Elements().empty());
    EXPECT_TRUE(text.Members().empty());
    EXPECT_EQ(JsonVariant(2.0).AsCString(), nullptr);
    EXPECT_EQ(JsonVariant(static_cast<const char*>(nullptr)).AsText(), "");
}

TEST(JsonVariant, AssignmentMovesAndEmptiesTheSource) {
    JsonVariant source = MustParse(R"({"a":[1,2]})");
    JsonVariant target("old text");
    target = std::move(source);
    EXPECT_TRUE(source.IsNone());  // NOLINT(bugprone-use-after-move): moved-from state is defined
    ASSERT_TRUE(target.IsObject());
    EXPECT_EQ(target.Find("a")->Size(), 2u);

    // A member moved over its own parent: the parent is replaced, the child lives on.
    JsonVariant parent = MustParse(R"({"child":{"x":1}})");
    parent = std::move(*parent.Find("child"));
    EXPECT_EQ(parent.Find("x")->AsNumber(), 1.0);

    JsonVariant self(3.0);
    JsonVariant& alias = self;
    self = std::move(alias);
    EXPECT_EQ(self.AsNumber(), 3.0);
}

TEST(JsonVariant, Comparison) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    EXPECT_TRUE(JsonVariant() == JsonVariant());
    EXPECT_TRUE(JsonVariant(JsonKind::Null) == JsonVariant(JsonKind::Null));
    EXPECT_FALSE(JsonVariant() == JsonVariant(JsonKind::Null));
    EXPECT_FALSE(JsonVariant(nan) == JsonVariant(nan));
    EXPECT_TRUE(JsonVariant(0.0) == JsonVariant(-0.0));
    EXPECT_FALSE(JsonVariant(1.0) == JsonVariant(true));
    EXPECT_FALSE(JsonVariant(std::string("a\0b", 3)) == JsonVariant("a"));
    EXPECT_TRUE(MustParse(R"({"a":[1,{"b":null}],"c":"x"})") ==
                MustParse(R"({"c":"x","a":[1,{"b":null}]})"));
    EXPECT_FALSE(MustParse("[1,2]") == MustParse("[2,1]"));
    EXPECT_FALSE(MustParse(R"({"a":1})") == MustParse(R"({"b":1})"));
    EXPECT_FALSE(MustParse(R"({"a":1})") == MustParse(R"({"a":1,"b":1})"));
    EXPECT_TRUE(MustParse(R"({"a":1})") != MustParse(R"({"a":2})"));
}

TEST(JsonVariant, MemberSettersKeepKeysSortedAndUnique) {
    JsonVariant json;
    json.SetNumber("b", 2.5);
    json.SetNumber("a", static_cast<uint32_t>(4000000000u));
    json.SetBool("ab", true);
    json.SetString("b", "replaced");
    json.SetString(std::string_view("a\0z", 3), "with zero");
    ASSERT_TRUE(json.IsObject());
    std::string keys;
    for (const JsonMember& m : json.Members()) keys += m.key.ToString() + "|";
    EXPECT_EQ(keys, std::string("a|a\0z|ab|b|", 11));
    EXPECT_EQ(json.Find("a")->AsNumber(), 4000000000.0);
    EXPECT_EQ(json.Find("b")->AsText(), "replaced");

    std::string text;
    EXPECT_TRUE(json.GetString("b", text));
    EXPECT_EQ(text, "replaced");
    EXPECT_FALSE(json.GetString("a", text));
    double number = 0;
    EXPECT_TRUE(json.GetDouble("a", number));
    EXPECT_FALSE(json.GetDouble("b", number));
    EXPECT_EQ(json.GetStringPointer("missing"), nullptr);
}

TEST(JsonVariant, GetFloat) {
    JsonVariant json;
    json.SetNumber("exact", 0.5);
    json.SetNumber("inexact", 0.1);
    json.SetNumber("huge", 1e300);
    float value = 0;
    EXPECT_TRUE(json.GetFloat("exact", value, true));
    EXPECT_EQ(value, 0.5f);
    EXPECT_FALSE(json.GetFloat("inexact", value, true));
    EXPECT_TRUE(json.GetFloat("inexact", value, false));
    EXPECT_EQ(value, 0.1f);
    EXPECT_FALSE(json.GetFloat("huge", value, false));
    EXPECT_FALSE(json.GetFloat("missing", value, false));
}

TEST(JsonVariant, GetOrAddContainers) {
    JsonVariant json = MustParse(R"({"obj":{"k":1},"arr":[1],"num":3})");
    EXPECT_EQ(json.GetOrAddObject("obj").Size(), 1u);
    EXPECT_EQ(json.GetOrAddObject("obj", true).Size(), 0u);
    EXPECT_TRUE(json.GetOrAddArray("num").IsArray());  // another kind is replaced
    json.GetOrAddArray("arr").Append("two");
    EXPECT_EQ(json.Find("arr")->Size(), 2u);
    json.GetOrAddObject("new").SetBool("deep", true);
    EXPECT_TRUE(json.Find("new")->Find("deep")->AsBool());
}

TEST(JsonVariant, Removal) {
    JsonVariant json = MustParse(R"({"a":1,"b":[1,2,3],"c":3})");
    EXPECT_TRUE(json.Remove("a"));
    EXPECT_FALSE(json.Remove("a"));
    EXPECT_TRUE(json.Find("b")->RemoveAt(1));
    EXPECT_FALSE(json.Find("b")->RemoveAt(5));
    EXPECT_TRUE(json == MustParse(R"({"b":[1,3],"c":3})"));
    json.RemoveAllExcept("c");
    EXPECT_TRUE(json == MustParse(R"({"c":3})"));
    json.Clear();
    EXPECT_TRUE(json.IsObject());
    EXPECT_EQ(json.Size(), 0u);
}

TEST(JsonVariant, ChangingKindInPlace) {
    JsonVariant json(5.0);
    json.SetString("text");
    EXPECT_EQ(json.AsText(), "text");
    json.SetString(json.AsText().substr(1));  // from its own text
    EXPECT_EQ(json.AsText(), "ext");
    json.SetEmptyString();
    EXPECT_TRUE(json.IsString());
    EXPECT_EQ(json.Size(), 0u);

    json.Append(1.0);
    json.Append(true);
    json.Append("s");
    json.AppendNull();
    json.Append(JsonVariant(JsonKind::Object));
    EXPECT_TRUE(json == MustParse(R"([1,true,"s",null,{}])"));
    json.SetEmptyArray();
    EXPECT_TRUE(json.IsArray());
    EXPECT_EQ(json.Size(), 0u);
    json.SetEmptyObject();
    EXPECT_TRUE(json.IsObject());
    json.SetNull();
    EXPECT_TRUE(json.IsNull());
    json.Clear();
    EXPECT_TRUE(json.IsNone());
}

TEST(JsonObjectBuilder, SortsOnceAndKeepsTheLastOfEqualKeys) {
    JsonObjectBuilder builder;
    for (int i = 40; i > 0; --i) builder.Add(std::to_string(i % 20), JsonVariant(double(i)));
    JsonVariant json("replaced");
    builder.Finish(json);
    ASSERT_EQ(json.Size(), 20u);
    EXPECT_EQ(json.Find("5")->AsNumber(), 5.0);
    std::string previous;
    for (const JsonMember& m : json.Members()) {
        EXPECT_LT(previous, m.key.ToString());
        previous = m.key.ToString();
    }
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
