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
    EXPECT_EQ(NewTagPathError(" a. "), std::nullopt);
    EXPECT_EQ(NewTagPathError("Zone/\xc3\xa9t\xc3\xa9.1"), std::nullopt);
}

TEST(TagPathRulesTest, AStarMatchesAnyRunDotsIncluded) {
    EXPECT_TRUE(MatchesSearchPath("a.*", "a.b.c"));
    EXPECT_TRUE(MatchesSearchPath("a.*", "a."));
    EXPECT_FALSE(MatchesSearchPath("a.*", "a"));
    EXPECT_TRUE(MatchesSearchPath("*.c", "a.b.c"));
    EXPECT_TRUE(MatchesSearchPath("a*b*c", "a-x-b-y-b-c"));
    EXPECT_FALSE(MatchesSearchPath("a*b*c", "a-x-b-y-c-d"));
    EXPECT_TRUE(MatchesSearchPath("***", ""));
    EXPECT_TRUE(MatchesSearchPath("***", "anything.at.all"));
    EXPECT_TRUE(MatchesSearchPath("", ""));
    EXPECT_FALSE(MatchesSearchPath("", "a"));
}

TEST(TagPathRulesTest, OtherCharactersMatchThemselvesCaseIncluded) {
    EXPECT_TRUE(MatchesSearchPath("a.b", "a.b"));
    EXPECT_FALSE(MatchesSearchPath("a.b", "A.b"));
    EXPECT_FALSE(MatchesSearchPath("a?b", "a.b"));
    EXPECT_FALSE(MatchesSearchPath("a.b", "a.bc"));
    EXPECT_FALSE(MatchesSearchPath("a.b", "xa.b"));
}

TEST(TagPathRulesTest, AnAbsentOrEmptyListMatchesEveryPath) {
    EXPECT_TRUE(MatchesAnySearchPath(std::nullopt, "x"));
    EXPECT_TRUE(MatchesAnySearchPath(VeldraMessageLibrary::JsonStringList{}, "x"));
    EXPECT_TRUE(MatchesAnySearchPath(VeldraMessageLibrary::JsonStringList{"y", "x*"}, "x1"));
    EXPECT_FALSE(MatchesAnySearchPath(VeldraMessageLibrary::JsonStringList{"y", "z*"}, "x1"));
}

}  // namespace
}  // namespace Korvane::Veldra::TagService
