#include <gtest/gtest.h>

#include "TagPathRules.h"

namespace Korvane::Veldra::TagService {
namespace {

TEST(TagPathRulesTest, NewPathsAreRefusedByTheFirstRuleTheyBreak) {
    EXPECT_EQ(NewTagPathError(""), "Tag.TagPathCannotBeEmpty");
    EXPECT_EQ(NewTagPathError("a.*"), "Tag.TagPathCannotContainAWildcard");
    EXPECT_EQ(NewTagPathError("*"), "Tag.TagPathCannotContainAWildcard");
    EXPECT_EQ(NewTagPathError(" . .\t"), "Tag.TagPathCannotContainOnlyWhiteSpaceAndDots");
    EXPECT_EQ(NewTagPathError("..."), "Tag.TagPathCannotContainOnlyWhiteSpaceAndDots");
    EXPECT_EQ(NewTagPathError(std::string("a\0b", 3)), "Tag.InvalidTagPath");
    EXPECT_EQ(NewTagPathError(" a. "), std::nullopt);
    EXPECT_EQ(NewTagPathError("Zone/\xc3\xa9t\xc3\xa9.1"), std::nullopt);
}

struct MatchCase {
    const char* pattern;
    const char* path;
    bool matches;
};

// '*' matches any run, dots included; every other character matches itself,
// case included.
TEST(TagPathRulesTest, SearchPatternsMatchWholePaths) {
    const MatchCase cases[] = {
        {"a.*", "a.b.c", true},   {"a.*", "a.", true},      {"a.*", "a", false},
        {"*.c", "a.b.c", true},   {"a*b*c", "a-x-b-y-b-c", true},
        {"a*b*c", "a-x-b-y-c-d", false},                    {"***", "", true},
        {"***", "any.path", true}, {"", "", true},          {"", "a", false},
        {"a.b", "a.b", true},     {"a.b", "A.b", false},    {"a?b", "a.b", false},
        {"a.b", "a.bc", false},   {"a.b", "xa.b", false},
    };
    for (const MatchCase& c : cases) {
        EXPECT_EQ(MatchesSearchPath(c.pattern, c.path), c.matches)
            << "'" << c.pattern << "' on '" << c.path << "'";
    }
}

TEST(TagPathRulesTest, AnAbsentOrEmptyListMatchesEveryPath) {
    EXPECT_TRUE(MatchesAnySearchPath(std::nullopt, "x"));
    EXPECT_TRUE(MatchesAnySearchPath(VeldraMessageLibrary::JsonStringList{}, "x"));
    EXPECT_TRUE(MatchesAnySearchPath(VeldraMessageLibrary::JsonStringList{"y", "x*"}, "x1"));
    EXPECT_FALSE(MatchesAnySearchPath(VeldraMessageLibrary::JsonStringList{"y", "z*"}, "x1"));
}

}  // namespace
}  // namespace Korvane::Veldra::TagService
