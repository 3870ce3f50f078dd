#include <gtest/gtest.h>

#include <cstring>
#include <string>

#include "messagelibrary/json/JsonScanner.h"

namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {
namespace {

struct MalformedCase {
    const char* text;
    int32_t code;
    std::size_t position;  // of the offending character
};

class MalformedText : public ::testing::TestWithParam<MalformedCase> {};

TEST_P(MalformedText, ReportsCodeAndPosition) {
    const MalformedCase& c = GetParam();
    JsonError error;
    EXPECT_FALSE(ValidateDocument(c.text, error));
    EXPECT_EQ(error.kind, 0);
    EXPECT_EQ(error.code, c.code) << ErrorName(error.code);
    ASSERT_NE(error.position, nullptr);
    EXPECT_EQ(static_cast<std::size_t>(error.position - c.text), c.position);
}

INSTANTIATE_TEST_SUITE_P(
    Scanner, MalformedText,
    ::testing::Values(MalformedCase{"", kErrorDoubleQuoteExpected, 0},
                      MalformedCase{"   ", kErrorDoubleQuoteExpected, 3},
                      MalformedCase{"x", kErrorDoubleQuoteExpected, 0},
                      MalformedCase{"[1,2,]", kErrorTrailingComma, 5},
                      MalformedCase{"{\"a\":1,}", kErrorTrailingComma, 7},
                      MalformedCase{"[1, \n ]", kErrorTrailingComma, 6},
                      MalformedCase{"{\"a\":1 \"b\":2}", kErrorCommaExpected, 7},
                      MalformedCase{"[1 2]", kErrorCommaExpected, 3},
                      MalformedCase{"{\"a\" 1}", kErrorColonExpected, 5},
                      MalformedCase{"{\"a\":1} x", kErrorTrailingChar, 8},
                      MalformedCase{"1 2", kErrorTrailingChar, 2},
                      MalformedCase{"trueish", kErrorTrailingChar, 4},
                      MalformedCase{"\"\\q\"", kErrorInvalidStringSequence, 2},
                      MalformedCase{"\"\\u12G4\"", kErrorInvalidStringSequence, 5},
                      MalformedCase{"\"\\u12\"", kErrorInvalidStringSequence, 5},
                      MalformedCase{"\"\\", kErrorInvalidStringSequence, 2},
                      MalformedCase{"\"a\nb\"", kErrorDoubleQuoteExpected, 2},
                      MalformedCase{"\"a\x7f\"", kErrorDoubleQuoteExpected, 2},
                      MalformedCase{"\"abc", kErrorDoubleQuoteExpected, 4},
                      MalformedCase{"{", kErrorCurlyBracketExpected, 1},
                      MalformedCase{"{\"a\":1", kErrorCurlyBracketExpected, 6},
                      MalformedCase{"{1:2}", kErrorDoubleQuoteExpected, 1},
                      MalformedCase{"{\"a\":}", kErrorDoubleQuoteExpected, 5},
                      MalformedCase{"[", kErrorSquareBracketExpected, 1},
                      MalformedCase{"[1", kErrorSquareBracketExpected, 2},
                      MalformedCase{"[,1]", kErrorDoubleQuoteExpected, 1},
                      MalformedCase{"[nul]", kErrorDoubleQuoteExpected, 1},
                      MalformedCase{"[tru", kErrorDoubleQuoteExpected, 1},
                      MalformedCase{"[\"a\":1]", kErrorCommaExpected, 4},
                      // The error of a nested value travels out unchanged.
                      MalformedCase{"{\"a\":[1,{\"b\" 2}]}", kErrorColonExpected, 13}));

TEST(JsonScanner, AcceptsWellFormedDocuments) {
    const char* documents[] = {
        "null",
        "true",
        "false",
        "0",
        "-1.5e+3",
        "007",
        "1.",
        "-",
        "1e+",
        "\"\"",
        " \t\r\n{ \"a\" : [ 1 , true , null , \"x\\u00e9\\n\" ] , \"b\" : { } } \n",
        "[[],{},[[]]]",
        "\"\xc3\xa9\"",
    };
    for (const char* text : documents) {
        JsonError error;
        EXPECT_TRUE(ValidateDocument(text, error)) << text << ": " << ErrorName(error.code);
    }
}

TEST(JsonScanner, NullTextIsTheOnlyValueExpected) {
    JsonError error;
    EXPECT_FALSE(ValidateDocument(nullptr, error));
    EXPECT_EQ(error.code, kErrorValueExpected);
    JsonToken token;
    EXPECT_EQ(ScanValue(nullptr, token, error), nullptr);
    EXPECT_EQ(error.code, kErrorValueExpected);
}

TEST(JsonScanner, TokensDescribeTheValue) {
    struct Case {
        const char* text;
        int32_t kind;
        std::size_t offset;
        std::size_t length;
        bool isFloat;
    };
    const Case cases[] = {
        {"  \"a\\nb\" ", 4, 1, 4, false}, {"-12 ", 3, 0, 3, false}, {"1.0", 3, 0, 3, true},
        {"2E5", 3, 0, 3, true},           {"1ex", 3, 0, 1, false},  {"[1, 2]", 5, 0, 6, false},
        {"{}", 6, 0, 2, false},           {"null", 1, 0, 4, false},
    };
    for (const Case& c : cases) {
        JsonToken token;
        JsonError error;
        const char* end = ScanValue(c.text, token, error);
        ASSERT_NE(end, nullptr) << c.text;
        EXPECT_EQ(token.kind, c.kind) << c.text;
        const char* valueStart = c.text + std::strspn(c.text, " ");
        EXPECT_EQ(static_cast<std::size_t>(token.start - valueStart), c.offset) << c.text;
        EXPECT_EQ(token.length, c.length) << c.text;
        EXPECT_EQ(token.isFloat, c.isFloat) << c.text;
    }
    JsonToken token;
    JsonError error;
    ASSERT_NE(ScanValue("false", token, error), nullptr);
    EXPECT_EQ(token.kind, 2);
    EXPECT_FALSE(token.boolean);
    ASSERT_NE(ScanValue("true", token, error), nullptr);
    EXPECT_TRUE(token.boolean);
}

TEST(JsonScanner, NestingDeeperThanTheLimitIsRefused) {
    const std::string deepest = std::string(kJsonMaxDepth, '[') + std::string(kJsonMaxDepth, ']');
    JsonError error;
    EXPECT_TRUE(ValidateDocument(deepest.c_str(), error));

    const std::string tooDeep = "[" + deepest + "]";
    EXPECT_FALSE(ValidateDocument(tooDeep.c_str(), error));
    EXPECT_EQ(error.code, kErrorSquareBracketExpected);

    // Far deeper than any stack would take without the limit.
    const std::string hostile(1000000, '{');
    EXPECT_FALSE(ValidateDocument(hostile.c_str(), error));
}

TEST(JsonScanner, ErrorNames) {
    EXPECT_STREQ(ErrorName(1), "jsonz_errorValueExpected");
    EXPECT_STREQ(ErrorName(5), "jsonz_errorColonExpected");
    EXPECT_STREQ(ErrorName(9), "jsonz_errorTrailingChar");
    EXPECT_STREQ(ErrorName(0), "unknown");
    EXPECT_STREQ(ErrorName(10), "unknown");
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
