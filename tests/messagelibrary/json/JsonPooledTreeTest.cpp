#include <gtest/gtest.h>

#include <string>
#include <utility>

#include "messagelibrary/json/JsonParser.h"
#include "messagelibrary/json/JsonVariantText.h"

// A parsed tree lives in one pool owned by its root. These tests change,
// move and drop such trees in every way the variant allows; the sanitizer
// builds then show any node freed twice or left behind.

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

// Long keys and texts (stored apart from their variant), a repeated key,
// nesting, and every scalar kind.
const std::string kDocument =
    R"({"a very long key indeed":"a text longer than eleven bytes","n":1.5,"t":true,)"
    R"("z":null,"list":[1,"short","another text longer than eleven",{"inner key longer":[]}],)"
    R"("dup":"first value of a repeated key","dup":"second value of the repeated key"})";

const std::string kSorted =
    R"({"a very long key indeed":"a text longer than eleven bytes",)"
    R"("dup":"second value of the repeated key",)"
    R"("list":[1,"short","another text longer than eleven",{"inner key longer":[]}],)"
    R"("n":1.5,"t":true,"z":null})";

JsonVariant MustParse(const std::string& text) {
    JsonVariant json;
    EXPECT_TRUE(Parse(json, text)) << text;
    return json;
}

TEST(JsonPooledTree, ReadsAsParsedAndSurvivesMoves) {
    JsonVariant json = MustParse(kDocument);
    EXPECT_EQ(ToJsonText(json), kSorted);
    // The root moves, into a variant and into another tree, and its pool with it.
    JsonVariant moved(std::move(json));
    JsonVariant holder(JsonKind::Array);
    holder.Append(std::move(moved));
    holder.Append(MustParse(R"(["one more text longer than eleven"])"));
    EXPECT_EQ(ToJsonText(*holder.At(0)), kSorted);
    // A change through the holder reaches the element, which copies its tree.
    holder.At(0)->SetString("added", "a text added to a parsed tree");
    EXPECT_EQ(holder.At(0)->Find("added")->AsText(), "a text added to a parsed tree");
    EXPECT_EQ(holder.At(0)->Find("dup")->AsText(), "second value of the repeated key");
    holder.RemoveAt(1);
    EXPECT_EQ(holder.Size(), 1u);
}

TEST(JsonPooledTree, EveryChangeThroughTheRootCopiesTheTreeFirst) {
    const auto changes = {
        +[](JsonVariant& j) { j.Find("list")->Append(2.0); },
        +[](JsonVariant& j) {
            j.Find("list")->At(3)->GetOrAddArray("x").Append("text of x, long");
        },
        +[](JsonVariant& j) { j.Elements(); },
        +[](JsonVariant& j) { j.Remove("n"); },
        +[](JsonVariant& j) { j.RemoveAllExcept("list"); },
        +[](JsonVariant& j) { j.Set("n", MustParse(R"({"k":"a long text of k"})")); },
        +[](JsonVariant& j) { j.GetOrAddObject("t", true); },
        +[](JsonVariant& j) { j.Clear(); },
        +[](JsonVariant& j) { j.SetEmptyObject(); },
        +[](JsonVariant& j) { j.SetString("replaced by a long text"); },
        +[](JsonVariant& j) { j.Reset(); },
        +[](JsonVariant& j) { j = MustParse(kDocument); },
    };
    for (const auto change : changes) {
        JsonVariant json = MustParse(kDocument);
        // A value read before the change keeps its text after it.
        const std::string before(json.Find("a very long key indeed")->AsText());
        change(json);
        EXPECT_EQ(before, "a text longer than eleven bytes");
        if (json.IsObject() && json.Find("a very long key indeed") != nullptr) {
            EXPECT_EQ(json.Find("a very long key indeed")->AsText(), before);
        }
    }
    JsonVariant json = MustParse(kDocument);
    json.Find("list")->Append(2.0);
    EXPECT_EQ(ToJsonText(*json.Find("list")),
              R"([1,"short","another text longer than eleven",{"inner key longer":[]},2])");
}

TEST(JsonPooledTree, FailedParsesAndOtherRootsLeaveNothingBehind) {
    JsonVariant json = MustParse(kDocument);
    // A failure deep inside: containers already built in the pool.
    EXPECT_FALSE(Parse(json, R"({"list":[1,"a text longer than eleven",{"k":[true,)"));
    EXPECT_TRUE(json.IsNone());
    EXPECT_FALSE(Parse(json, R"({"a":"a text longer than eleven","a":"again a long text",)"));
    EXPECT_FALSE(Parse(json, R"([{"a long key of the object":1},1e+])"));
    // Roots that are no container keep nothing of the pool.
    EXPECT_EQ(MustParse(R"("a root text longer than eleven")").AsText(),
              "a root text longer than eleven");
    EXPECT_EQ(MustParse("12").AsNumber(), 12.0);
    EXPECT_EQ(MustParse("[]").Size(), 0u);
    EXPECT_EQ(MustParse("{}").Size(), 0u);
    // An object of many members, some repeated, sorted as a whole.
    std::string many = "{";
    for (int i = 40; i >= 0; --i)
        many += "\"key number " + std::to_string(i % 37) + "\":" + std::to_string(i) + ",";
    many.back() = '}';
    const JsonVariant sorted = MustParse(many);
    EXPECT_EQ(sorted.Size(), 37u);
    EXPECT_EQ(sorted.Find("key number 3")->AsNumber(), 3.0);  // 40 came first, 3 last
    EXPECT_EQ(sorted.Find("key number 36")->AsNumber(), 36.0);
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
