#include "TagServiceLogicFixture.h"

namespace Korvane::Veldra::TagService::Testing {
namespace {

using TagInfoLogicTest = TagServiceLogicFixture;
using Flags = Tags::TagChangeFlags;

TEST_F(TagInfoLogicTest, CreateRefusesBadPathsAndTypesAndKeepsAnEqualTag) {
    EXPECT_EQ(ErrorOf(logic.CreateTag(TagInfo::TagInfoCreateTagRoutedMessage(std::nullopt))),
              "Tag.TagPathCannotBeEmpty");
    EXPECT_EQ(ErrorOf(logic.CreateTag(TagInfo::TagInfoCreateTagRoutedMessage(
                  Record(". .", TagDataType::Int)))),
              "Tag.TagPathCannotContainOnlyWhiteSpaceAndDots");
    EXPECT_EQ(ErrorOf(logic.CreateTag(TagInfo::TagInfoCreateTagRoutedMessage(
                  Record("t", TagDataType::None)))),
              "Tag.InvalidTagType");
    EXPECT_EQ(ErrorOf(logic.CreateTag(TagInfo::TagInfoCreateTagRoutedMessage(
                  Record("s", TagDataType::String, true)))),
              "Tag.StringTagCannotCollectAggregates");
    EXPECT_EQ(Query(std::nullopt).totalCount, 0);

    Create(Record("t", TagDataType::Int, false, JsonStringList{"k"}));
    const Outcome same = logic.CreateTag(
        TagInfo::TagInfoCreateTagRoutedMessage(Record("t", TagDataType::Int, true)));
    EXPECT_FALSE(same.error);
    EXPECT_TRUE(same.broadcasts.empty());
    EXPECT_FALSE(store.Find("t")->record.collectAggregates);
    EXPECT_EQ(store.Find("t")->record.keywords, JsonStringList{"k"});

    const Outcome other = logic.CreateTag(
        TagInfo::TagInfoCreateTagRoutedMessage(Record("t", TagDataType::Double)));
    ASSERT_TRUE(other.error);
    EXPECT_EQ(other.error->FullName(), "Tag.TagAlreadyExists");
    EXPECT_EQ(other.error->args, std::vector<std::string>{"t"});
    EXPECT_EQ(other.error->info, "Tag already exists: 't'.");
}

TEST_F(TagInfoLogicTest, QueryFiltersSortsAndPagesWithTheCountBeforePaging) {
    Create(Record("b.2", TagDataType::Int, false, JsonStringList{"x", "y"},
                  JsonStringMap{{"unit", "m"}, {"zone", "1"}}));
    Create(Record("a.1", TagDataType::Int, false, JsonStringList{"x"}, JsonStringMap{{"unit", "m"}}));
    Create(Record("b.1", TagDataType::Int, false, JsonStringList{"y"}, JsonStringMap{{"unit", "s"}}));
    Create(Record("c", TagDataType::Int));

    EXPECT_EQ(Paths(Query(std::nullopt)), (std::vector<std::string>{"a.1", "b.1", "b.2", "c"}));
    EXPECT_EQ(Paths(Query(JsonStringList{})), (std::vector<std::string>{"a.1", "b.1", "b.2", "c"}));
    EXPECT_EQ(Paths(Query(JsonStringList{"b.*", "c"})),
              (std::vector<std::string>{"b.1", "b.2", "c"}));
    EXPECT_EQ(Paths(Query(JsonStringList{"c", "a.1"})), (std::vector<std::string>{"a.1", "c"}));
    EXPECT_EQ(Paths(Query(std::nullopt, 0, 0, JsonStringMap{{"unit", "m"}})),
              (std::vector<std::string>{"a.1", "b.2"}));
    EXPECT_EQ(Paths(Query(std::nullopt, 0, 0, JsonStringMap{{"unit", "m"}, {"zone", "1"}})),
              (std::vector<std::string>{"b.2"}));
    EXPECT_EQ(Paths(Query(std::nullopt, 0, 0, std::nullopt, JsonStringList{"x", "y"})),
              (std::vector<std::string>{"b.2"}));
    EXPECT_EQ(Paths(Query(JsonStringList{"a.*"}, 0, 0, std::nullopt, JsonStringList{"y"})),
              std::vector<std::string>{});

    const TagPage page = Query(JsonStringList{"*"}, 1, 2);
    EXPECT_EQ(Paths(page), (std::vector<std::string>{"b.1", "b.2"}));
    EXPECT_EQ(page.totalCount, 4);
    EXPECT_EQ(Query(JsonStringList{"*"}, 10, 2).totalCount, 4);
    EXPECT_TRUE(Query(JsonStringList{"*"}, 10, 2).tags.empty());
    EXPECT_EQ(Paths(Query(JsonStringList{"*"}, -3, -1)).size(), 4u);
}

TEST_F(TagInfoLogicTest, CreateOrUpdateChangesOnlyFlaggedFieldsMergingOrReplacing) {
    Create(Record("t", TagDataType::Int, false, JsonStringList{"a", "b"},
                  JsonStringMap{{"k1", "1"}, {"k2", "2"}}));
    const TagRecord change = Record("t", TagDataType::Int, true, JsonStringList{"c", "a", "c"},
                                    JsonStringMap{{"k2", "new"}, {"k3", "3"}});

    auto outcome = logic.CreateOrUpdateTags(TagInfo::TagInfoCreateOrUpdateTagsRequest(
        std::vector<Tags::TagChange>{{change, Flags::Keywords}}, true));
    EXPECT_FALSE(outcome.errors);
    EXPECT_EQ(outcome.broadcasts.size(), 1u);
    EXPECT_EQ(store.Find("t")->record.keywords, (JsonStringList{"a", "b", "c"}));
    EXPECT_EQ(store.Find("t")->record.properties->size(), 2u);
    EXPECT_FALSE(store.Find("t")->record.collectAggregates);

    logic.CreateOrUpdateTags(TagInfo::TagInfoCreateOrUpdateTagsRequest(
        std::vector<Tags::TagChange>{{change, Flags::Properties | Flags::CollectAggregates}},
        true));
    EXPECT_EQ(store.Find("t")->record.properties,
              (JsonStringMap{{"k1", "1"}, {"k2", "new"}, {"k3", "3"}}));
    EXPECT_TRUE(store.Find("t")->record.collectAggregates);

    logic.CreateOrUpdateTags(TagInfo::TagInfoCreateOrUpdateTagsRequest(
        std::vector<Tags::TagChange>{{change, Flags::Keywords | Flags::Properties}}, false));
    EXPECT_EQ(store.Find("t")->record.keywords, (JsonStringList{"c", "a"}));
    EXPECT_EQ(store.Find("t")->record.properties, (JsonStringMap{{"k2", "new"}, {"k3", "3"}}));

    logic.CreateOrUpdateTags(TagInfo::TagInfoCreateOrUpdateTagsRequest(
        std::vector<Tags::TagChange>{{Record("t", TagDataType::Int), Flags::None}}, false));
    EXPECT_EQ(store.Find("t")->record.keywords, (JsonStringList{"c", "a"}));
}

TEST_F(TagInfoLogicTest, CreateOrUpdateReportsEachFailureAndAppliesTheGoodChanges) {
    Create(Record("s", TagDataType::String));
    Create(Record("d", TagDataType::Double));
    auto outcome = logic.CreateOrUpdateTags(TagInfo::TagInfoCreateOrUpdateTagsRequest(
        std::vector<Tags::TagChange>{
            {Record("s", TagDataType::String, true, JsonStringList{"k"}),
             Flags::Keywords | Flags::CollectAggregates},
            {Record("nope", TagDataType::Double), Flags::Keywords},
            {Record("d", TagDataType::Double, false, JsonStringList{"k"}), Flags::Keywords},
            {std::nullopt, Flags::Keywords}},
        true));
    ASSERT_TRUE(outcome.errors);
    EXPECT_EQ(outcome.errors->name, "Veldra.OneOrMoreErrorsOccurred");
    ASSERT_EQ(outcome.errors->innerErrors->size(), 3u);
    const ErrorRecord& first = outcome.errors->innerErrors->at(0);
    EXPECT_EQ(first.name, "Tag.StringTagCannotCollectAggregates");
    EXPECT_EQ(first.args, JsonStringList{"s"});
    EXPECT_EQ(first.resourceId, "s");
    EXPECT_EQ(first.message, "Tag 's' has type string and cannot collect aggregates.");
    EXPECT_EQ(outcome.errors->innerErrors->at(1).name, "Tag.NoSuchTag");
    EXPECT_EQ(outcome.errors->innerErrors->at(1).resourceId, "nope");
    EXPECT_EQ(outcome.errors->innerErrors->at(2).resourceId, "");
    // A failed change is not applied in part; the good one is applied.
    EXPECT_TRUE(store.Find("s")->record.keywords->empty());
    EXPECT_EQ(store.Find("d")->record.keywords, JsonStringList{"k"});
    EXPECT_EQ(outcome.broadcasts.size(), 1u);
}

TEST_F(TagInfoLogicTest, UpdateTagChangesWhatItCarries) {
    Create(Record("t", TagDataType::Int, true, JsonStringList{"a"}, JsonStringMap{{"k", "1"}}));
    EXPECT_EQ(ErrorOf(logic.UpdateTag(TagInfo::TagInfoUpdateTagRoutedMessage(
                  std::string("none"), std::nullopt, std::nullopt, std::nullopt, false))),
              "Tag.NoSuchTag");
    const Outcome merged = logic.UpdateTag(TagInfo::TagInfoUpdateTagRoutedMessage(
        std::string("t"), JsonStringList{"b"}, std::nullopt, Tags::CollectAggregatesChange::None,
        false));
    EXPECT_FALSE(merged.error);
    ASSERT_EQ(merged.broadcasts.size(), 1u);
    EXPECT_EQ(merged.broadcasts[0]->MessageType(), "TagInfoTagMetadataUpdatedBroadcast");
    EXPECT_EQ(store.Find("t")->record.keywords, (JsonStringList{"a", "b"}));
    EXPECT_TRUE(store.Find("t")->record.collectAggregates);
    logic.UpdateTag(TagInfo::TagInfoUpdateTagRoutedMessage(
        std::string("t"), std::nullopt, JsonStringMap{{"j", "2"}},
        Tags::CollectAggregatesChange::Disable, true));
    EXPECT_EQ(store.Find("t")->record.properties, (JsonStringMap{{"j", "2"}}));
    EXPECT_EQ(store.Find("t")->record.keywords, (JsonStringList{"a", "b"}));
    EXPECT_FALSE(store.Find("t")->record.collectAggregates);

    Create(Record("s", TagDataType::String));
    EXPECT_EQ(ErrorOf(logic.UpdateTag(TagInfo::TagInfoUpdateTagRoutedMessage(
                  std::string("s"), std::nullopt, std::nullopt,
                  Tags::CollectAggregatesChange::Enable, false))),
              "Tag.StringTagCannotCollectAggregates");
}

TEST_F(TagInfoLogicTest, DeleteTakesPatternsAndTheirValuesWithThem) {
    for (const char* path : {"a.1", "a.2", "b.1", "c"}) Create(Record(path, TagDataType::Double));
    ASSERT_FALSE(Write({{std::string("a.1"), std::vector<Tags::TagValueSample>{Sample("1")}}}).error);

    EXPECT_TRUE(logic.DeleteTags(TagInfo::TagInfoDeleteTagsRoutedMessage(std::nullopt))
                    .broadcasts.empty());
    EXPECT_TRUE(logic.DeleteTags(TagInfo::TagInfoDeleteTagsRoutedMessage(JsonStringList{"x*"}))
                    .broadcasts.empty());
    const Outcome some =
        logic.DeleteTags(TagInfo::TagInfoDeleteTagsRoutedMessage(JsonStringList{"a.*", "c"}));
    EXPECT_FALSE(some.error);
    EXPECT_EQ(some.broadcasts.size(), 1u);
    EXPECT_EQ(Paths(Query(std::nullopt)), std::vector<std::string>{"b.1"});

    Create(Record("a.1", TagDataType::Double));
    EXPECT_FALSE(Read({"a.1"}).at(0).current);

    logic.DeleteTags(TagInfo::TagInfoDeleteTagsRoutedMessage(JsonStringList{"***"}));
    EXPECT_EQ(Query(std::nullopt).totalCount, 0);
}

}  // namespace
}  // namespace Korvane::Veldra::TagService::Testing
