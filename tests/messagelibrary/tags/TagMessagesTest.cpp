#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "messagelibrary/GenericMessage.h"
#include "messagelibrary/MessageBodyChecks.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using Testing::ExpectRefusals;
using Testing::Parse;
using Testing::Written;
using namespace TagIngestionMessages;
using namespace TagCurrentValueMessages;
using namespace TagInfoMessages;
using MessageBus::MessageBody;

TEST(TagMessages, WriteTheExampleBodies) {
    const Timestamp time(boost::gregorian::date(2016, 3, 1), boost::posix_time::hours(12));
    const TagUpdateValuesRoutedMessage update(std::vector<TagPathUpdates>{
        {std::string("a.b"),
         std::vector<TagValueSample>{{time, TagValue{TagDataType::Double, std::string("1.5")}}}}});
    const std::string updateBody =
        R"({"updates":[{"path":"a.b","updates":[{"timestamp":"2016-03-01T12:00:00Z",)"
        R"("value":{"type":"DOUBLE","value":"1.5"}}]}]})";
    EXPECT_EQ(Written(update), updateBody);
    const auto parsed = Parse<TagUpdateValuesRoutedMessage>(updateBody);
    const TagValueSample& sample = parsed.Updates()->at(0).updates->at(0);
    EXPECT_EQ(sample.timestamp, time);
    EXPECT_EQ(sample.value->type, TagDataType::Double);
    EXPECT_EQ(sample.value->value, "1.5");

    const std::string queryBody = R"({"paths":["a.b","a.c"],"allowStale":false})";
    EXPECT_EQ(Written(TagCvQueryCurrentValuesByPathRequest(JsonStringList{"a.b", "a.c"}, false)),
              queryBody);
    EXPECT_EQ(Parse<TagCvQueryCurrentValuesByPathRequest>(queryBody).Paths(),
              (JsonStringList{"a.b", "a.c"}));
}

TEST(TagMessages, RefusedFieldsNameTheKeyWithTheCodeOfItsType) {
    const auto query = Parse<TagInfoQueryTagsRequest>;
    const auto create = Parse<TagInfoCreateTagRoutedMessage>;
    const auto update = Parse<TagInfoUpdateTagRoutedMessage>;
    const auto change = Parse<TagInfoCreateOrUpdateTagsRequest>;
    ExpectRefusals({
        {query, R"({"skip":true})", -251005, "skip"},
        {query, R"({"take":1e10})", -251005, "take"},
        {query, R"({"allowStale":null})", -251005, "allowStale"},
        {query, R"({"searchPaths":"a"})", -251005, "searchPaths"},
        {query, R"({"keywords":[1]})", -251005, "keywords"},
        {query, R"({"properties":{"a":1}})", -251005, "properties"},
        {query, R"({"properties":[]})", -251005, "properties"},
        {update, R"({"path":5})", -251005, "path"},
        {update, R"({"collectAggregates":"enable"})", -251004, "collectAggregates"},
        {update, R"({"collectAggregates":true})", -251004, "collectAggregates"},
        {create, R"({"newTag":[]})", -251004, "newTag"},
        {create, R"({"newTag":{"type":"BOOL"}})", -251004, "newTag"},
        {create, R"({"newTag":{"collectAggregates":"true"}})", -251004, "newTag"},
        {change, R"({"tags":{}})", -251005, "tags"},
        {change, R"({"tags":[{"changes":["NAME"]}]})", -251005, "tags"},
        {change, R"({"tags":[{"changes":"KEYWORDS"}]})", -251005, "tags"},
        {Parse<TagInfoCreateOrUpdateTagsResponse>, R"({"errors":{"innerErrors":[{"args":[2]}]}})",
         -251004, "errors"},
        {Parse<TagCvQueryCurrentValuesByPathResponse>,
         R"({"values":[{"current":{"timestamp":"yesterday"}}]})", -251005, "values"},
    });
}

TEST(TagMessages, EnumerationsReadTheirTextsAndAnyNumber) {
    const auto type = [](const std::string& json) {
        return Parse<TagInfoCreateTagRoutedMessage>(R"({"newTag":{"type":)" + json + "}}")
            .NewTag()
            ->type;
    };
    EXPECT_EQ(type(R"("BOOLEAN")"), TagDataType::Boolean);
    EXPECT_EQ(type(R"("DATE_TIME")"), TagDataType::DateTime);
    EXPECT_EQ(type("5"), TagDataType::UInt64);
    EXPECT_EQ(type("6.9"), TagDataType::DateTime);
    EXPECT_EQ(type("null"), std::nullopt);

    const auto written = [](const std::string& json) {
        const std::string body = R"({"path":null,"keywords":null,"properties":null,)"
                                 R"("collectAggregates":)" +
                                 json + R"(,"replace":false})";
        return Written(Parse<TagInfoUpdateTagRoutedMessage>(body)) == body;
    };
    EXPECT_TRUE(written(R"("ENABLE")"));
    EXPECT_TRUE(written("null"));
    const auto odd = Parse<TagInfoUpdateTagRoutedMessage>(R"({"collectAggregates":99})");
    EXPECT_EQ(odd.CollectAggregates(), static_cast<CollectAggregatesChange>(99));
    EXPECT_NE(Written(odd).find(R"("collectAggregates":"",)"), std::string::npos);
}

TEST(TagMessages, ChangeFlagsAreWrittenAsAListOfNames) {
    const auto written = [](std::optional<TagChangeFlags> flags) {
        return Written(
            TagInfoCreateOrUpdateTagsRequest(std::vector<TagChange>{{std::nullopt, flags}}, false));
    };
    const auto body = [](const std::string& changes) {
        return R"({"tags":[{"tag":null,"changes":)" + changes + R"(}],"merge":false})";
    };
    const auto flags = [](int32_t bits) { return static_cast<TagChangeFlags>(bits); };
    EXPECT_EQ(written(std::nullopt), body("null"));
    EXPECT_EQ(written(TagChangeFlags::None), body("[]"));
    EXPECT_EQ(written(flags(7)), body(R"(["KEYWORDS", "PROPERTIES", "COLLECT_AGGREGATES"])"));
    EXPECT_EQ(written(flags(4 | 16)), body(R"(["COLLECT_AGGREGATES"])"));
    EXPECT_EQ(written(flags(8)), body("null"));
    EXPECT_EQ(written(flags(-1)), body(R"(["KEYWORDS", "PROPERTIES", "COLLECT_AGGREGATES"])"));

    const auto read = [&](const std::string& changes) {
        return Parse<TagInfoCreateOrUpdateTagsRequest>(body(changes)).Tags()->at(0).changes;
    };
    EXPECT_EQ(read("null"), std::nullopt);
    EXPECT_EQ(read("[]"), TagChangeFlags::None);
    EXPECT_EQ(read(R"(["COLLECT_AGGREGATES","KEYWORDS","KEYWORDS"])"), flags(5));
    EXPECT_EQ(read(R"([2, 8])"), flags(10));
    EXPECT_EQ(Parse<TagInfoCreateOrUpdateTagsRequest>(R"({"tags":[{}]})").Tags()->at(0).changes,
              std::nullopt);
}

TEST(TagMessages, AnAverageOfNaNMakesABodyThatCannotBeRead) {
    const MessageBus::MessageHeaders request;
    TagAggregates aggregates;
    aggregates.avg = std::nan("");
    const TagCvQueryCurrentValuesByPathResponse response(
        MessageBus::GenericMessage(request, MessageBody()),
        std::vector<TagCurrentValue>{{std::string("a.b"), std::nullopt, aggregates}});
    const std::string body = Written(response);
    EXPECT_NE(body.find(R"("avg":NaN,)"), std::string::npos);
    EXPECT_THROWS_VELDRA(Parse<TagCvQueryCurrentValuesByPathResponse>(body), -251005,
                         "Failed to parse: TagCvQueryCurrentValuesByPathResponse");

    const auto avg = [](const char* json) {
        return Parse<TagCvQueryCurrentValuesByPathResponse>(
                   std::string(R"({"values":[{"aggregates":{"avg":)") + json + "}}]}")
            .Values()
            ->at(0)
            .aggregates->avg;
    };
    EXPECT_TRUE(std::isnan(avg(R"("NaN")")));
    EXPECT_EQ(avg(R"("-Infinity")"), -HUGE_VAL);
    EXPECT_EQ(avg(R"("2.5")"), 2.5);
}

TEST(TagMessages, UnsetRecordsAreWrittenNullAndReadBackUnset) {
    const std::string body = R"({"values":[{"path":"a.b","current":null,"aggregates":null},null]})";
    const auto parsed = Parse<TagCvQueryCurrentValuesByPathResponse>(body);
    ASSERT_EQ(parsed.Values()->size(), 2u);
    EXPECT_FALSE(parsed.Values()->at(0).aggregates.has_value());
    EXPECT_FALSE(parsed.Values()->at(1).path.has_value());
    EXPECT_EQ(Written(parsed), R"({"values":[{"path":"a.b","current":null,"aggregates":null},)"
                               R"({"path":null,"current":null,"aggregates":null}]})");
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
