#include "TagServiceLogicFixture.h"
#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"

namespace Korvane::Veldra::TagService::Testing {
namespace {

using TagValueLogicTest = TagServiceLogicFixture;
using Tags::TagPathUpdates;
using Tags::TagValueSample;

Timestamp At(int hour) {
    return Timestamp(boost::gregorian::date(2016, 3, 1), boost::posix_time::hours(hour));
}

TEST_F(TagValueLogicTest, AMessageWithOneBadSampleChangesNothing) {
    Create(Record("d", TagDataType::Double, true));
    Create(Record("i", TagDataType::Int));
    ASSERT_FALSE(Write({{std::string("d"), std::vector<TagValueSample>{Sample("1", At(1))}}}).error);

    const Outcome badValue =
        Write({{std::string("d"), std::vector<TagValueSample>{Sample("5", At(2))}},
               {std::string("i"), std::vector<TagValueSample>{Sample("7"), Sample("7.5")}}});
    ASSERT_TRUE(badValue.error);
    EXPECT_EQ(badValue.error->FullName(), "Tag.InvalidTagValue");
    EXPECT_EQ(badValue.error->args.front(), "i");
    EXPECT_TRUE(badValue.broadcasts.empty());

    const Outcome unknown =
        Write({{std::string("d"), std::vector<TagValueSample>{Sample("5", At(2))}},
               {std::string("gone"), std::vector<TagValueSample>{Sample("1")}}});
    ASSERT_TRUE(unknown.error);
    EXPECT_EQ(unknown.error->FullName(), "Tag.NoSuchTag");
    EXPECT_EQ(unknown.error->args, std::vector<std::string>{"gone"});
    EXPECT_EQ(unknown.error->info, "No such tag: 'gone'.");

    TagValueSample noValue{At(3), std::nullopt};
    EXPECT_EQ(ErrorOf(Write({{std::string("d"), std::vector<TagValueSample>{noValue}}})),
              "Tag.InvalidTagValue");

    const auto values = Read({"d", "i"});
    EXPECT_EQ(values.at(0).current->value->value, "1");
    EXPECT_EQ(values.at(0).aggregates->count, 1);
    EXPECT_FALSE(values.at(1).current);
}

TEST_F(TagValueLogicTest, SamplesApplyInOrderAndTheTagsTypeJudgesThem) {
    Create(Record("d", TagDataType::Double, true));
    Create(Record("u", TagDataType::UInt64));
    // The sample's own type is not what counts: the tag's is.
    const TagValueSample asString{At(4), Tags::TagValue{TagDataType::String, "18446744073709551615"}};
    const Outcome outcome =
        Write({{std::string("d"), std::vector<TagValueSample>{Sample("3", At(5)), Sample("1")}},
               {std::string("u"), std::vector<TagValueSample>{asString}},
               {std::string("d"), std::vector<TagValueSample>{Sample("8", At(6))}}});
    ASSERT_FALSE(outcome.error);
    const auto values = Read({"u", "d"});
    EXPECT_EQ(values.at(0).current->value->type, TagDataType::UInt64);
    EXPECT_EQ(values.at(1).current->value->value, "8");
    EXPECT_EQ(values.at(1).current->timestamp, At(6));
    EXPECT_EQ(values.at(1).aggregates->count, 3);
    EXPECT_DOUBLE_EQ(values.at(1).aggregates->avg, 4.0);
    EXPECT_EQ(values.at(1).aggregates->min, "1");

    // One broadcast with an update set per entry, each sample with the
    // aggregates after it; the sample without a time got the receive time.
    ASSERT_EQ(outcome.broadcasts.size(), 1u);
    const auto& broadcast =
        dynamic_cast<const TagIngest::TagNewTagsIngestedBroadcast&>(*outcome.broadcasts[0]);
    ASSERT_EQ(broadcast.Updates()->size(), 3u);
    const auto& first = broadcast.Updates()->at(0);
    EXPECT_EQ(first.tag->path, "d");
    ASSERT_EQ(first.updates->size(), 2u);
    EXPECT_EQ(first.updates->at(1).timestamp, ReceiveTime());
    EXPECT_EQ(first.updates->at(1).aggregates->count, 2);
    EXPECT_FALSE(broadcast.Updates()->at(1).updates->at(0).aggregates);
}

TEST_F(TagValueLogicTest, CurrentValuesComeInRequestOrderWithoutUnknownPaths) {
    Create(Record("a", TagDataType::Double, true));
    Create(Record("b", TagDataType::Boolean, true));
    Create(Record("s", TagDataType::String));
    ASSERT_FALSE(Write({{std::string("b"), std::vector<TagValueSample>{
                                               {At(1), Tags::TagValue{TagDataType::Boolean, "True"}}}}})
                     .error);
    const auto values = Read({"b", "x", "a", "s", "b"});
    ASSERT_EQ(values.size(), 4u);
    EXPECT_EQ(values[0].path, "b");
    EXPECT_EQ(values[0].current->value->value, "True");
    EXPECT_FALSE(values[0].aggregates);  // not numeric
    EXPECT_EQ(values[1].path, "a");
    EXPECT_FALSE(values[1].current);
    ASSERT_TRUE(values[1].aggregates);  // collected, nothing yet
    EXPECT_EQ(values[1].aggregates->count, 0);
    EXPECT_FALSE(values[2].aggregates);
    EXPECT_EQ(values[3].path, "b");
}

TEST_F(TagValueLogicTest, ResetZeroesAggregatesAndRefusesUnknownPaths) {
    Create(Record("a", TagDataType::Int, true));
    ASSERT_FALSE(Write({{std::string("a"), std::vector<TagValueSample>{Sample("4", At(1))}}}).error);
    EXPECT_EQ(ErrorOf(logic.ResetAggregates(
                  TagCv::TagCvResetAggregatesRoutedMessage(JsonStringList{"a", "nope"}))),
              "Tag.NoSuchTag");
    EXPECT_EQ(Read({"a"}).at(0).aggregates->count, 1);

    const Outcome reset =
        logic.ResetAggregates(TagCv::TagCvResetAggregatesRoutedMessage(JsonStringList{"a"}));
    EXPECT_FALSE(reset.error);
    ASSERT_EQ(reset.broadcasts.size(), 1u);
    const auto value = Read({"a"}).at(0);
    EXPECT_EQ(value.aggregates->count, 0);
    EXPECT_FALSE(value.aggregates->min);
    EXPECT_EQ(value.current->value->value, "4");

    ASSERT_FALSE(Write({{std::string("a"), std::vector<TagValueSample>{Sample("6")}}}).error);
    EXPECT_EQ(Read({"a"}).at(0).aggregates->max, "6");
}

TEST_F(TagValueLogicTest, TurningCollectionOffAndOnStartsAggregatesAfresh) {
    Create(Record("a", TagDataType::Int, true));
    ASSERT_FALSE(Write({{std::string("a"), std::vector<TagValueSample>{Sample("4")}}}).error);
    for (bool collect : {false, true}) {
        logic.CreateOrUpdateTags(TagInfo::TagInfoCreateOrUpdateTagsRequest(
            std::vector<Tags::TagChange>{{Record("a", TagDataType::Int, collect),
                                          Tags::TagChangeFlags::CollectAggregates}},
            true));
    }
    EXPECT_EQ(Read({"a"}).at(0).aggregates->count, 0);
}

// The flag is kept on a bool or date-time tag, but nothing is counted there.
TEST_F(TagValueLogicTest, BoolAndDateTimeTagsKeepTheFlagAndCountNothing) {
    Create(Record("b", TagDataType::Boolean, true));
    Create(Record("t", TagDataType::DateTime, true));
    ASSERT_FALSE(Write({{std::string("b"), std::vector<TagValueSample>{Sample("True")}},
                        {std::string("t"),
                         std::vector<TagValueSample>{Sample("2026-03-01T08:30:00.250000Z")}}})
                     .error);
    for (const auto& value : Read({"b", "t"})) {
        EXPECT_TRUE(value.current) << *value.path;
        EXPECT_FALSE(value.aggregates) << *value.path;
    }
    for (const auto& tag : Query(JsonStringList{"b", "t"}).tags) {
        EXPECT_EQ(tag.collectAggregates, true) << *tag.path;
    }
}

}  // namespace
}  // namespace Korvane::Veldra::TagService::Testing
