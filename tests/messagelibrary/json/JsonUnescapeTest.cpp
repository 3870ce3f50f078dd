#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "messagelibrary/json/JsonUnescape.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

// The raw characters between the quotes, as a string token holds them.
std::string Decode(const char* raw, bool* complete = nullptr) {
    std::string out = "previous";
    const bool done = UnescapeJsonString(raw, std::strlen(raw), out);
    if (complete != nullptr) *complete = done;
    return out;
}

TEST(JsonUnescape, DecodesEscapes) {
    struct Case {
        const char* raw;
        std::string decoded;
    };
    const Case cases[] = {
        {"plain", "plain"},
        {R"(\"\/\\\b\f\n\r\t)", "\"/\\\b\f\n\r\t"},
        {R"(\u0041\u00e9\u00E9)", "A\xc3\xa9\xc3\xa9"},
        {R"(\u20ac)", "\xe2\x82\xac"},
        {R"(\ud83d\ude00)", "\xf0\x9f\x98\x80"},      // U+1F600
        {R"(x\uD800\uDC00y)", "x\xf0\x90\x80\x80y"},  // U+10000
        {R"(\udbff\udfff)", "\xf4\x8f\xbf\xbf"},      // U+10FFFF
        {"\xc3\xa9", "\xc3\xa9"},                     // UTF-8 passes through
        {"", ""},
        // An escaped zero at the very end ends the sequence with the input.
        {R"(abc\u0000)", "abc"},
    };
    for (const Case& c : cases) {
        bool complete = false;
        EXPECT_EQ(Decode(c.raw, &complete), c.decoded) << c.raw;
        EXPECT_TRUE(complete) << c.raw;
    }
}

TEST(JsonUnescape, FailureEmptiesTheWholeText) {
    const char* failures[] = {
        R"(ab\ud83dcd)",    // lone high surrogate
        R"(ab\ude00)",      // lone low surrogate
        R"(\ud83d\u)",      // pair cut short
        R"(\udfff\uffff)",  // pair beyond 0x1FFFFF
        R"(ab\u0000cd)",    // escaped zero before the end
        R"(ab\q)",          // unknown escape
        R"(ab\)",           // backslash at the end
        R"(\u12)",          // short hex
    };
    for (const char* raw : failures) {
        bool complete = true;
        EXPECT_EQ(Decode(raw, &complete), "") << raw;
        EXPECT_FALSE(complete) << raw;
    }
}

TEST(JsonUnescape, IteratorHandsOutOneByteAtATime) {
    const char raw[] = R"(a\ud83d\ude00b)";
    JsonUnescaper bytes(raw, sizeof(raw) - 1);
    const std::string expected =
        "a\xf0\x9f\x98\x80"
        "b";
    for (const char c : expected) EXPECT_EQ(bytes.Next(), c);
    EXPECT_EQ(bytes.Next(), '\0');
    EXPECT_TRUE(bytes.Complete());
    EXPECT_EQ(bytes.Next(), '\0');  // stays ended
}

TEST(JsonUnescape, NeverReadsBeyondTheGivenLength) {
    // The escape is cut by the length; the bytes behind must not be used.
    const char raw[] = R"(\u00e9)";
    for (std::size_t length = 1; length < 6; ++length) {
        std::string out;
        EXPECT_FALSE(UnescapeJsonString(raw, length, out)) << length;
        EXPECT_EQ(out, "");
    }
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
