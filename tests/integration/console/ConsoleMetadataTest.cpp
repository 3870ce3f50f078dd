// Keywords, properties, aggregates and deletion through the exported console functions.
#include "console/ConsoleTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(ConsoleBrokerTest, KeywordsAndPropertiesAreReplacedAndReadBack) {
    const uint32_t reference = Open(UniquePath("metadata"), kDouble);
    std::string error;
    for (const std::vector<std::string>& keywords :
         {std::vector<std::string>{"old"}, std::vector<std::string>{"pump", "north"}}) {
        ASSERT_EQ(TagConsoleSetKeywords(reference, &keywords, false, &error), 0) << error;
    }
    const TagConsoleProperties properties{{"unit", "bar"}, {"site", "A \"quoted\" name"}};
    ASSERT_EQ(TagConsoleSetProperties(reference, &properties, false, &error), 0) << error;

    // What the caller holds is kept: keywords are appended, properties assigned.
    std::vector<std::string> keywords{"mine"};
    ASSERT_EQ(TagConsoleGetKeywords(reference, false, &keywords, &error), 0) << error;
    EXPECT_EQ(keywords, (std::vector<std::string>{"mine", "pump", "north"}));
    TagConsoleProperties read{{"unit", "stale"}, {"mine", "kept"}};
    ASSERT_EQ(TagConsoleGetProperties(reference, false, &read, &error), 0) << error;
    EXPECT_EQ(read, (TagConsoleProperties{
                        {"unit", "bar"}, {"site", "A \"quoted\" name"}, {"mine", "kept"}}));
    Close(reference);
}

TEST_F(ConsoleBrokerTest, AggregatesAreCollectedResetAndRefusedForStrings) {
    const uint32_t text = Open(UniquePath("text"), kString);
    std::string error;
    EXPECT_EQ(TagConsoleSetCollectAggregates(text, true, false, &error),
              kStringTagCannotCollectAggregates);

    const uint32_t number = Open(UniquePath("number"), kDouble);
    ASSERT_EQ(TagConsoleSetCollectAggregates(number, true, false, &error), 0) << error;
    bool collecting = false;
    ASSERT_EQ(TagConsoleGetCollectAggregates(number, false, &collecting, &error), 0) << error;
    EXPECT_TRUE(collecting);

    const TagConsoleSamples samples{{"1", TagConsoleTime(std::chrono::seconds(1))},
                                    {"3", TagConsoleTime(std::chrono::seconds(2))}};
    ASSERT_EQ(TagConsoleWriteTag(number, kDouble, &samples, false, &error), 0) << error;
    TagConsoleValue read = ReadOne(number);
    EXPECT_EQ(read.aggregateCount, 2);
    EXPECT_DOUBLE_EQ(read.aggregateAverage, 2.0);

    const std::vector<uint32_t> references{number, 0xFFFFFFF1u};
    EXPECT_EQ(TagConsoleResetAggregates(0, &references, false, &error), kInvalidTagReference);
    read = ReadOne(number);
    EXPECT_EQ(read.aggregateCount, 0);
    Close(text);
    Close(number);
}

TEST_F(ConsoleBrokerTest, ADeletedTagIsGoneOnTheServiceButStillOpenHere) {
    const std::string path = UniquePath("deleted");
    const uint32_t reference = Open(path, kBoolean);
    const std::vector<uint32_t> references{reference};
    std::string error;
    ASSERT_EQ(TagConsoleDeleteTag(0, &references, false, &error), 0) << error;

    std::vector<std::string> keywords;
    EXPECT_EQ(TagConsoleGetKeywords(reference, false, &keywords, &error), kNoSuchTag);
    std::string answer;
    EXPECT_EQ(TagConsoleGetPath(reference, false, &answer, &error), 0) << error;
    EXPECT_EQ(answer, path);
    int32_t type = -1;
    EXPECT_EQ(TagConsoleGetDataType(reference, false, &type, &error), 0) << error;
    EXPECT_EQ(type, kBoolean);
    Close(reference);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
