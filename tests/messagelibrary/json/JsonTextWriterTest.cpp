#include <gtest/gtest.h>

#include <cstring>
#include <string>
#include <vector>

#include "messagelibrary/json/JsonRawAccess.h"
#include "messagelibrary/json/JsonTextWriter.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

// A document buffer of a fixed size.
struct Buffer {
    explicit Buffer(std::size_t size) : bytes(size, 'x') {}
    char* data() { return bytes.data(); }
    std::string Text() const { return std::string(bytes.data()); }
    // Everything behind the text is zero up to the sentinel.
    bool ContractHolds() const {
        const std::size_t length = std::strlen(bytes.data());
        for (std::size_t i = length; i + 1 < bytes.size(); ++i) {
            if (bytes[i] != '\0') return false;
        }
        return bytes.back() == kJsonSentinel;
    }
    std::vector<char> bytes;
};

TEST(JsonTextWriter, InitDocument) {
    Buffer buffer(8);
    char* at = InitDocument(buffer.data(), 8, "{}");
    ASSERT_EQ(at, buffer.data() + 1);
    EXPECT_EQ(buffer.Text(), "{}");
    EXPECT_TRUE(buffer.ContractHolds());
    EXPECT_EQ(InitDocument(buffer.data(), 3, "{}"), nullptr);  // no room for the sentinel
    EXPECT_NE(InitDocument(buffer.data(), 4, "{}"), nullptr);
    EXPECT_EQ(InitDocument(buffer.data(), 8, "x"), nullptr);
    EXPECT_EQ(InitDocument(nullptr, 8, "{}"), nullptr);
}

TEST(JsonTextWriter, WritesEveryValueKindWithCommas) {
    Buffer buffer(512);
    char* at = InitDocument(buffer.data(), 512, "{}");
    at = WriteNull(at, "n");
    at = WriteBool(at, "t", true);
    at = WriteBool(at, "f", false);
    at = WriteString(at, "s\"", "a\x01\x7f/");
    at = WriteDouble(at, "d", 0.1);
    at = WriteUInt64(at, "u64", 18446744073709551615ull);
    at = WriteInt64(at, "i64", -9223372036854775807ll);
    at = WriteUInt32(at, "u32", 4294967295u);
    at = WriteInt32(at, "i32", -5);
    at = WriteRaw(at, "raw", "[1, 2]");
    char* inside = WriteArray(at, "arr");
    inside = WriteInt32(inside, nullptr, 1);
    inside = WriteObject(inside, nullptr);
    inside = CloseContainer(inside);
    inside = WriteArray(inside, nullptr);
    at = CloseContainer(CloseContainer(inside));
    at = WriteObject(at, "o");
    ASSERT_NE(at, nullptr);
    EXPECT_EQ(buffer.Text(), R"({"n":null,"t":true,"f":false,"s\"":"a\u0001\u007f/",)"
                             R"("d":0.10000000000000000555,"u64":18446744073709551615,)"
                             R"("i64":-9223372036854775807,"u32":4294967295,"i32":-5,"raw":[1, 2],)"
                             R"("arr":[1,{},[]],"o":{}})");
    EXPECT_TRUE(buffer.ContractHolds());
}

TEST(JsonTextWriter, InsertionBeforeExistingElementsPutsTheCommaBehind) {
    Buffer buffer(64);
    char* first = InitDocument(buffer.data(), 64, "[]");
    WriteInt32(first, nullptr, 2);
    WriteInt32(first, nullptr, 1);  // again right behind the "["
    EXPECT_EQ(buffer.Text(), "[1,2]");
    EXPECT_TRUE(buffer.ContractHolds());
}

TEST(JsonTextWriter, ExactlyTooSmallFailsWithoutACallback) {
    // "[1]" needs 3 bytes, a terminator and the sentinel: 5. One less fails.
    Buffer small(4 + 1);
    char* at = InitDocument(small.data(), 5, "[]");
    Buffer tooSmall(4);
    char* none = InitDocument(tooSmall.data(), 4, "[]");
    EXPECT_NE(WriteInt32(at, nullptr, 1), nullptr);
    EXPECT_EQ(small.Text(), "[1]");
    EXPECT_EQ(WriteInt32(none, nullptr, 1), nullptr);
    EXPECT_EQ(tooSmall.Text(), "[]");
    EXPECT_TRUE(tooSmall.ContractHolds());
}

struct Growth {
    std::vector<char> bytes;
    int calls = 0;
};

char* GrowByOne(void* context, char* at) {
    auto& growth = *static_cast<Growth*>(context);
    ++growth.calls;
    const std::size_t offset = static_cast<std::size_t>(at - growth.bytes.data());
    growth.bytes.resize(growth.bytes.size() + 1);
    InitDocument(growth.bytes.data(), growth.bytes.size(), growth.bytes.data());
    return growth.bytes.data() + offset;
}

char* Refuse(void*, char*) {
    return nullptr;
}

TEST(JsonTextWriter, OneByteShortTriggersOneGrowth) {
    Growth growth;
    growth.bytes.resize(4);
    char* at = InitDocument(growth.bytes.data(), 4, "[]");
    const JsonGrow grow{&GrowByOne, &growth};
    at = WriteInt32(at, nullptr, 7, &grow);
    ASSERT_NE(at, nullptr);
    EXPECT_EQ(growth.calls, 1);
    EXPECT_EQ(std::string(growth.bytes.data()), "[7]");

    const JsonGrow refuse{&Refuse, nullptr};
    EXPECT_EQ(WriteString(at, "k", "long text", &refuse), nullptr);
}

TEST(JsonTextWriter, RemovalTakesTheDanglingCommaAndKeepsTheContract) {
    struct Case {
        const char* document;
        std::size_t index;
        const char* remaining;
    };
    const Case cases[] = {
        {"[1,2,3]", 0, "[2,3]"},
        {"[1,2,3]", 1, "[1,3]"},
        {"[1,2,3]", 2, "[1,2]"},
        {"[1]", 0, "[]"},
        {"[[1,2],{\"a\":[]}]", 1, "[[1,2]]"},
    };
    for (const Case& c : cases) {
        Buffer buffer(32);
        InitDocument(buffer.data(), 32, c.document);
        EXPECT_TRUE(RemoveElement(buffer.data(), c.index)) << c.document;
        EXPECT_EQ(buffer.Text(), c.remaining) << c.document;
        EXPECT_TRUE(buffer.ContractHolds()) << c.document;
    }
    Buffer buffer(64);
    InitDocument(buffer.data(), 64, R"({"a":1,"b":[2],"c":"3"})");
    EXPECT_TRUE(RemoveMember(buffer.data(), "b"));
    EXPECT_EQ(buffer.Text(), R"({"a":1,"c":"3"})");
    EXPECT_TRUE(RemoveMember(buffer.data(), "c"));
    EXPECT_FALSE(RemoveMember(buffer.data(), "zz"));
    EXPECT_EQ(buffer.Text(), R"({"a":1})");
    EXPECT_FALSE(RemoveElement(buffer.data(), 0));  // no array
    EXPECT_TRUE(buffer.ContractHolds());
}

TEST(JsonRawAccess, ReadsValuesWithoutATree) {
    const char* text = R"( {"b":true,"s":"x\ny","u":42,"f":2.0,"neg":-1,"d":-1.5e2,)"
                       R"("arr":[10, "two", [3], {"k":4}]} )";
    EXPECT_TRUE(RawBool(RawFindMember(text, "b"), false));
    std::size_t length = 0;
    const char* s = RawText(RawFindMember(text, "s"), length, nullptr);
    ASSERT_NE(s, nullptr);
    EXPECT_EQ(std::string(s, length), "x\\ny");
    EXPECT_EQ(RawUInt64(RawFindMember(text, "u"), 0), 42u);
    EXPECT_EQ(RawUInt32(RawFindMember(text, "f"), 0), 2u);
    EXPECT_EQ(RawUInt32(RawFindMember(text, "neg"), 9), 9u);
    EXPECT_EQ(RawDouble(RawFindMember(text, "d"), 0), -150.0);
    EXPECT_EQ(RawDouble(RawFindMember(text, "s"), 7.0), 7.0);  // kind mismatch
    EXPECT_EQ(RawFindMember(text, "missing"), nullptr);

    const char* arr = RawFindMember(text, "arr");
    EXPECT_EQ(RawElementCount(arr), 4u);
    EXPECT_EQ(RawUInt32(RawElementAt(arr, 0), 0), 10u);
    EXPECT_EQ(RawUInt32(RawFindMember(RawElementAt(arr, 3), "k"), 0), 4u);
    EXPECT_EQ(RawElementAt(arr, 4), nullptr);
    EXPECT_EQ(RawElementCount("[]"), 0u);

    std::string keys;
    for (const char* m = RawFirstMember(text); m != nullptr; m = RawNextMember(m)) {
        const char* key = RawMemberKey(m, length);
        keys.append(key, length).push_back(',');
    }
    EXPECT_EQ(keys, "b,s,u,f,neg,d,arr,");
}

TEST(JsonRawAccess, MalformedTextGivesDefaults) {
    const char* broken[] = {"", "{", "{\"a\"", "{\"a\":", "[1,", "[1,]", "{\"a\":1,}", "\"", "-"};
    for (const char* text : broken) {
        EXPECT_EQ(RawUInt32(text, 5), 5u) << text;
        EXPECT_EQ(RawElementCount(text), text[0] == '[' ? 1u : 0u) << text;
    }
    for (const char* text : {"{", "{\"a\"", "{\"a\":", "{\"a\":}", "{\"a\":-}"}) {
        EXPECT_EQ(RawUInt32(RawFindMember(text, "a"), 5), 5u) << text;
    }
    EXPECT_EQ(RawBool(nullptr, true), true);
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
