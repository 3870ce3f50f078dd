#pragma once

#include <string>
#include <vector>

#include "messagelibrary/taghistorian/HistorianRecords.h"
#include "messagelibrary/taghttp/TagSelection.h"
#include "messagelibrary/tags/TagSamples.h"
#include "messagelibrary/tagsubscription/SubscriptionRecords.h"

// Records of the historian, subscription and selection messages with every
// field set, and their written forms.

namespace Korvane::Veldra::VeldraMessageLibrary::Testing {

using TagHistorianMessages::HistorianValueMap;

inline const std::string kUnsetTimeJson = R"("0001-01-01T00:00:00")";

// endTime stays unset.
inline TagHistorianMessages::HistorianQuery SampleQuery() {
    return {JsonStringList{"a.b"},
            SampleTime(),
            Timestamp(),
            -1,
            100,
            10,
            TagHistorianMessages::HistorianSortOrder::Descending};
}
inline const std::string kQueryJson = R"({"paths":["a.b"],"startTime":)" + kTimeJson +
                                      R"(,"endTime":)" + kUnsetTimeJson +
                                      R"(,"skip":-1,"take":100,"decimation":10,)"
                                      R"("sortOrder":"DESCENDING"})";

inline TagHistorianMessages::HistorianQueryJob SampleJob() {
    return {SampleQuery(), std::string("r1"), true};
}
inline const std::string kJobJson =
    R"({"query":)" + kQueryJson + R"(,"requestId":"r1","hasError":true})";

inline TagHistorianMessages::HistorianValue SampleHistorianValue() {
    return {std::string("v1"),  kOddPath,     TagDataType::Double,
            std::string("1.5"), SampleTime(), JsonStringMap{{"k", "v"}},
            SampleTime()};
}
inline const std::string kHistorianValueJson =
    R"({"id":"v1","path":)" + kOddPathJson + R"(,"type":"DOUBLE","value":"1.5","timestamp":)" +
    kTimeJson + R"(,"properties":{"k":"v"},"expirationDate":)" + kTimeJson + "}";

// Paths in the order they are written; one has no values.
inline HistorianValueMap SampleValueMap() {
    return {{"a.b", {SampleHistorianValue(), SampleHistorianValue()}}, {"a.a", {}}};
}
inline const std::string kValueMapJson =
    R"({"a.a":[],"a.b":[)" + kHistorianValueJson + "," + kHistorianValueJson + "]}";

inline TagSubscriptionCommunicatorMessages::SubscriptionOptions SampleOptions() {
    return {TagSubscriptionCommunicatorMessages::SubscriptionUpdateMode::ImmediateNotification,
            true, 30};
}
inline const std::string kOptionsJson =
    R"({"updateMode":"IMMEDIATE_NOTIFICATION","updatesOnly":true,"batchIntervalSeconds":30})";

inline TagSubscriptionCommunicatorMessages::SubscriptionUpdate SampleSubscriptionUpdate() {
    return {std::string("s1"),
            std::string("al"),
            std::vector<TagUpdateSet>{{SampleRecord(), std::vector{SampleUpdate()}}},
            JsonStringList{"c"},
            JsonStringList{},
            std::nullopt};
}
inline const std::string kSubscriptionUpdateJson =
    R"({"subscriptionId":"s1","alias":"al","updates":[{"tag":)" + kRecordJson + R"(,"updates":[)" +
    kUpdateJson + R"(]}],"createdTags":["c"],"deletedTags":[],"nonexistentTags":null})";

inline TagHttpMessages::TagSelection SampleSelection() {
    return {std::string("sel1"), JsonStringList{"a.*"}, 600};
}
inline const std::string kSelectionJson =
    R"({"id":"sel1","searchPaths":["a.*"],"inactivityTimeout":600})";

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Testing
