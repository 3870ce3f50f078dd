#include <gtest/gtest.h>

#include <vector>

#include "messagelibrary/MessageClassCases.h"
#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathRequest.h"
#include "messagelibrary/tagcurrentvalue/TagCvQueryCurrentValuesByPathResponse.h"
#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"
#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"
#include "messagelibrary/tagingestion/TagNewJournalsWrittenBroadcast.h"
#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"
#include "messagelibrary/tagingestion/TagUpdateValuesRoutedMessage.h"
#include "messagelibrary/tags/TagSamples.h"

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using namespace VeldraMessageLibrary;
using namespace VeldraMessageLibrary::Testing;
using namespace VeldraMessageLibrary::TagIngestionMessages;
using namespace VeldraMessageLibrary::TagCurrentValueMessages;
using namespace VeldraMessageLibrary::TagInfoMessages;
using Request = const Interfaces::IRoutingSource&;

const JsonStringList kPaths{"a.b", ""};
const std::string kPathsJson = R"(["a.b",""])";

std::vector<MessageCase> TagCases() {
    const TagPathUpdates pathUpdates{kOddPath, std::vector<TagValueSample>{SampleSample()}};
    const TagAggregatedUpdates aggregated{std::string("a.b"),
                                          std::vector<TagValueUpdate>{SampleUpdate()}};
    const TagUpdateSet updateSet{SampleRecord(), std::vector<TagValueUpdate>{SampleUpdate()}};
    const TagCurrentValue current{std::string("a.b"), SampleSample(), SampleAggregates()};
    const TagChange change{SampleRecord(), TagChangeFlags::Keywords | TagChangeFlags::Properties};
    return {
        MessageCaseOf<TagNewJournalsWrittenBroadcast>(
            "Veldra.TagNewJournalsWrittenBroadcast", R"({"journalIds":)" + kPathsJson + "}",
            [] { return TagNewJournalsWrittenBroadcast(kPaths); }),
        MessageCaseOf<TagNewTagsIngestedBroadcast>(
            "Veldra.TagNewTagsIngestedBroadcast",
            R"({"updates":[{"tag":)" + kRecordJson + R"(,"updates":[)" + kUpdateJson + "]}]}",
            [=] { return TagNewTagsIngestedBroadcast(std::vector<TagUpdateSet>{updateSet}); }),
        MessageCaseOf<TagUpdateValuesRoutedMessage>(
            "Veldra.TagIngestion.TagUpdateValuesRoutedMessage",
            R"({"updates":[{"path":)" + kOddPathJson + R"(,"updates":[)" + kSampleJson + "]}]}",
            [=] { return TagUpdateValuesRoutedMessage(std::vector<TagPathUpdates>{pathUpdates}); }),
        MessageCaseOf<TagCvAggregatesResetBroadcast>(
            "Veldra.TagCvAggregatesResetBroadcast",
            R"({"updates":[{"path":"a.b","updates":[)" + kUpdateJson + "]}]}",
            [=] {
                return TagCvAggregatesResetBroadcast(std::vector<TagAggregatedUpdates>{aggregated});
            }),
        MessageCaseOf<TagCvQueryCurrentValuesByPathRequest>(
            "Veldra.TagCurrentValue.TagCvQueryCurrentValuesByPathRequest",
            R"({"paths":)" + kPathsJson + R"(,"allowStale":true})",
            [] { return TagCvQueryCurrentValuesByPathRequest(kPaths, true); }),
        MessageCaseOf<TagCvQueryCurrentValuesByPathResponse>(
            "Veldra.client_q.TagCvQueryCurrentValuesByPathResponse",
            R"({"values":[{"path":"a.b","current":)" + kSampleJson + R"(,"aggregates":)" +
                kAggregatesJson + "}]}",
            [=](Request r) {
                return TagCvQueryCurrentValuesByPathResponse(r, std::vector{current});
            }),
        MessageCaseOf<TagCvResetAggregatesRoutedMessage>(
            "Veldra.TagCurrentValue.TagCvResetAggregatesRoutedMessage",
            R"({"paths":)" + kPathsJson + "}",
            [] { return TagCvResetAggregatesRoutedMessage(kPaths); }),
        MessageCaseOf<TagInfoCreateOrUpdateTagsRequest>(
            "Veldra.TagInfo.TagInfoCreateOrUpdateTagsRequest",
            R"({"tags":[{"tag":)" + kRecordJson +
                R"(,"changes":["KEYWORDS", "PROPERTIES"]}],"merge":true})",
            [=] { return TagInfoCreateOrUpdateTagsRequest(std::vector{change}, true); }),
        MessageCaseOf<TagInfoCreateOrUpdateTagsResponse>(
            "Veldra.client_q.TagInfoCreateOrUpdateTagsResponse", R"({"errors":)" + kErrorJson + "}",
            [](Request r) { return TagInfoCreateOrUpdateTagsResponse(r, SampleError()); }),
        MessageCaseOf<TagInfoCreateTagRoutedMessage>(
            "Veldra.TagInfo.TagInfoCreateTagRoutedMessage", R"({"newTag":)" + kRecordJson + "}",
            [] { return TagInfoCreateTagRoutedMessage(SampleRecord()); }),
        MessageCaseOf<TagInfoDeleteTagsRoutedMessage>(
            "Veldra.TagInfo.TagInfoDeleteTagsRoutedMessage", R"({"paths":)" + kPathsJson + "}",
            [] { return TagInfoDeleteTagsRoutedMessage(kPaths); }),
        MessageCaseOf<TagInfoDeletedTagsBroadcast>(
            "Veldra.TagInfoDeletedTagsBroadcast", R"({"tags":)" + kPathsJson + "}",
            [] { return TagInfoDeletedTagsBroadcast(kPaths); }),
        MessageCaseOf<TagInfoQueryTagsRequest>(
            "Veldra.TagInfo.TagInfoQueryTagsRequest",
            R"({"searchPaths":["a.*"],"properties":{"k":"v"},"keywords":[],"skip":-2,)"
            R"("take":100,"allowStale":true})",
            [] {
                return TagInfoQueryTagsRequest(JsonStringList{"a.*"}, JsonStringMap{{"k", "v"}},
                                               JsonStringList{}, -2, 100, true);
            }),
        MessageCaseOf<TagInfoQueryTagsResponse>(
            "Veldra.client_q.TagInfoQueryTagsResponse",
            R"({"tags":[)" + kRecordJson + R"(],"totalCount":2147483647})",
            [](Request r) {
                return TagInfoQueryTagsResponse(r, std::vector{SampleRecord()}, 2147483647);
            }),
        MessageCaseOf<TagInfoTagMetadataUpdatedBroadcast>(
            "Veldra.TagInfoTagMetadataUpdatedBroadcast", R"({"updatedTag":)" + kRecordJson + "}",
            [] { return TagInfoTagMetadataUpdatedBroadcast(SampleRecord()); }),
        MessageCaseOf<TagInfoUpdateTagRoutedMessage>(
            "Veldra.TagInfo.TagInfoUpdateTagRoutedMessage",
            R"({"path":"a.b","keywords":["k"],"properties":{},"collectAggregates":"DISABLE",)"
            R"("replace":true})",
            [] {
                return TagInfoUpdateTagRoutedMessage(std::string("a.b"), JsonStringList{"k"},
                                                     JsonStringMap{},
                                                     CollectAggregatesChange::Disable, true);
            }),
    };
}

INSTANTIATE_TEST_SUITE_P(TagMessages, MessageClassTest, ::testing::ValuesIn(TagCases()),
                         [](const auto& info) { return info.param.name; });
INSTANTIATE_TEST_SUITE_P(TagMessages, MessageResponseTest,
                         ::testing::ValuesIn(ResponsesOf(TagCases())),
                         [](const auto& info) { return info.param.name; });

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
