#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "messagelibrary/MessageClassCases.h"
#include "messagelibrary/historian/HistorianSamples.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryCompleteRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryDataRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryResponse.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncSubscribeRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncSubscribeResponse.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncUnsubscribeRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncUnsubscribeResponse.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncValuesProcessedRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByIdRequest.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByIdResponse.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByRangeRequest.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByRangeResponse.h"
#include "messagelibrary/taghistorian/TagHistorianFlushValuesRequest.h"
#include "messagelibrary/taghistorian/TagHistorianFlushValuesResponse.h"
#include "messagelibrary/taghistorian/TagHistorianQueryRequest.h"
#include "messagelibrary/taghistorian/TagHistorianQueryResponse.h"
#include "messagelibrary/taghistorian/TagHistorianUpdateValuesRequest.h"
#include "messagelibrary/taghistorian/TagHistorianUpdateValuesResponse.h"
#include "messagelibrary/taghistorian/TagHistorianValuesProcessedBroadcast.h"
#include "messagelibrary/taghttp/TagHttpCreateSelectionRequest.h"
#include "messagelibrary/taghttp/TagHttpCreateSelectionResponse.h"
#include "messagelibrary/taghttp/TagHttpDeleteSelectionRoutedMessage.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionRequest.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionResponse.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionsRequest.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionsResponse.h"
#include "messagelibrary/taghttp/TagHttpUpdateSelectionRoutedMessage.h"
#include "messagelibrary/taghttp/TagSelection.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionsRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionsResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorPushedUpdateRoutedMessage.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscribeRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscribeResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscriptionHeartbeatRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorSubscriptionHeartbeatResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorUnsubscribeRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorUnsubscribeResponse.h"

namespace Korvane::Veldra::MessageBus::Testing {
namespace {

using namespace VeldraMessageLibrary;
using namespace VeldraMessageLibrary::Testing;
using namespace VeldraMessageLibrary::TagHistorianMessages;
using namespace VeldraMessageLibrary::TagSubscriptionCommunicatorMessages;
using namespace VeldraMessageLibrary::TagHttpMessages;
using Request = const Interfaces::IRoutingSource&;

const JsonStringList kIds{"i1", ""};
const std::string kIdsJson = R"(["i1",""])";

// A case whose routing key is "Veldra." + queue + the class name; queue ends
// with its dot, and responses answer a request whose reply queue is client_q.
template <typename M, typename Make>
MessageCase To(const std::string& queue, std::string body, Make make) {
    return MessageCaseOf<M>("Veldra." + queue + M::kMessageName, std::move(body), make);
}
const std::string kHistorian = "TagHistorian.";
const std::string kSubscription = "TagSubscriptionCommunicator.";
const std::string kHttp = "TagHttp.";
const std::string kReply = "client_q.";

std::vector<MessageCase> HistorianCases() {
    const HistorianAsyncValues asyncValues{std::string("r1"), SampleValueMap(), 3, SampleError(),
                                           JsonStringList{"a.c"}};
    const std::string asyncValuesJson = R"({"requestId":"r1","values":)" + kValueMapJson +
                                        R"(,"totalCount":3,"errors":)" + kErrorJson +
                                        R"(,"failed":["a.c"]})";
    const HistorianValues values{SampleValueMap(), -3, std::nullopt, JsonStringList{}};
    const std::string valuesJson =
        R"({"values":)" + kValueMapJson + R"(,"totalCount":-3,"errors":null,"failed":[]})";
    const HistorianValueUpdate valueUpdate{std::string("v1"), JsonStringMap{}, SampleTime()};
    const std::string valueUpdateJson =
        R"({"id":"v1","properties":{},"expirationDate":)" + kTimeJson + "}";
    const HistorianDeleteRange range{std::string("a.b"), SampleTime(), Timestamp()};
    const std::string rangeJson =
        R"({"path":"a.b","startTime":)" + kTimeJson + R"(,"endTime":)" + kUnsetTimeJson + "}";
    const std::string jobsJson = R"({"queryJobs":[)" + kJobJson + "]}";
    const std::string valueListJson = R"({"values":[)" + kHistorianValueJson + "]}";
    const std::vector<HistorianValue> valueList{SampleHistorianValue()};
    return {
        To<TagHistorianAsyncQueryCompleteRoutedMessage>(
            kReply, jobsJson,
            [](Request r) {
                return TagHistorianAsyncQueryCompleteRoutedMessage(r, std::vector{SampleJob()});
            }),
        To<TagHistorianAsyncQueryDataRoutedMessage>(
            kReply, R"({"tagHistorianAsyncValues":)" + asyncValuesJson + "}",
            [=](Request r) { return TagHistorianAsyncQueryDataRoutedMessage(r, asyncValues); }),
        To<TagHistorianAsyncQueryRequest>(
            kHistorian, R"({"queries":[)" + kQueryJson + "]}",
            [] { return TagHistorianAsyncQueryRequest(std::vector{SampleQuery()}); }),
        To<TagHistorianAsyncQueryResponse>(
            kReply, jobsJson,
            [](Request r) { return TagHistorianAsyncQueryResponse(r, std::vector{SampleJob()}); }),
        To<TagHistorianAsyncSubscribeRequest>(
            kHistorian, R"({"searchPaths":)" + kIdsJson + "}",
            [] { return TagHistorianAsyncSubscribeRequest(kIds); }),
        To<TagHistorianAsyncSubscribeResponse>(
            kReply, "{}", [](Request r) { return TagHistorianAsyncSubscribeResponse(r); }),
        To<TagHistorianAsyncUnsubscribeRequest>(
            kHistorian, R"({"searchPaths":)" + kIdsJson + "}",
            [] { return TagHistorianAsyncUnsubscribeRequest(kIds); }),
        To<TagHistorianAsyncUnsubscribeResponse>(
            kReply, "{}", [](Request r) { return TagHistorianAsyncUnsubscribeResponse(r); }),
        To<TagHistorianAsyncValuesProcessedRoutedMessage>(
            kReply, valueListJson,
            [=](Request r) { return TagHistorianAsyncValuesProcessedRoutedMessage(r, valueList); }),
        To<TagHistorianDeleteValuesByIdRequest>(
            kHistorian, R"({"path":"a.b","ids":)" + kIdsJson + "}",
            [] { return TagHistorianDeleteValuesByIdRequest(std::string("a.b"), kIds); }),
        To<TagHistorianDeleteValuesByIdResponse>(
            kReply, "{}", [](Request r) { return TagHistorianDeleteValuesByIdResponse(r); }),
        To<TagHistorianDeleteValuesByRangeRequest>(
            kHistorian, R"({"ranges":[)" + rangeJson + "]}",
            [=] { return TagHistorianDeleteValuesByRangeRequest(std::vector{range}); }),
        To<TagHistorianDeleteValuesByRangeResponse>(
            kReply, "{}", [](Request r) { return TagHistorianDeleteValuesByRangeResponse(r); }),
        To<TagHistorianFlushValuesRequest>(kHistorian, "{}",
                                           [] { return TagHistorianFlushValuesRequest(); }),
        To<TagHistorianFlushValuesResponse>(
            kReply, "{}", [](Request r) { return TagHistorianFlushValuesResponse(r); }),
        To<TagHistorianQueryRequest>(kHistorian,
                                     R"({"paths":)" + kIdsJson + R"(,"startTime":)" + kTimeJson +
                                         R"(,"endTime":)" + kUnsetTimeJson +
                                         R"(,"skip":0,"take":-5,"decimation":2147483647,)"
                                         R"("sortOrder":"ASCENDING"})",
                                     [] {
                                         return TagHistorianQueryRequest(
                                             kIds, SampleTime(), Timestamp(), 0, -5, 2147483647,
                                             HistorianSortOrder::Ascending);
                                     }),
        To<TagHistorianQueryResponse>(
            kReply, R"({"tagHistorianValues":)" + valuesJson + "}",
            [=](Request r) { return TagHistorianQueryResponse(r, values); }),
        To<TagHistorianUpdateValuesRequest>(
            kHistorian, R"({"path":)" + kOddPathJson + R"(,"values":[)" + valueUpdateJson + "]}",
            [=] { return TagHistorianUpdateValuesRequest(kOddPath, std::vector{valueUpdate}); }),
        To<TagHistorianUpdateValuesResponse>(
            kReply, R"({"errors":)" + kErrorJson + "}",
            [](Request r) { return TagHistorianUpdateValuesResponse(r, SampleError()); }),
        To<TagHistorianValuesProcessedBroadcast>(
            "", valueListJson, [=] { return TagHistorianValuesProcessedBroadcast(valueList); }),
    };
}

std::vector<MessageCase> SubscriptionAndSelectionCases() {
    using Update = SubscriptionUpdate;
    const std::string updatesJson = "[" + kSubscriptionUpdateJson + "]";
    return {
        To<TagSubscriptionCommunicatorGetSubscriptionRequest>(
            kSubscription, R"({"subscriptionId":"s1"})",
            [] { return TagSubscriptionCommunicatorGetSubscriptionRequest(std::string("s1")); }),
        To<TagSubscriptionCommunicatorGetSubscriptionResponse>(
            kReply,
            R"({"validSubscription":true,"alias":"al","options":)" + kOptionsJson + R"(,"tags":)" +
                kIdsJson + "}",
            [](Request r) {
                return TagSubscriptionCommunicatorGetSubscriptionResponse(
                    r, true, std::string("al"), SampleOptions(), kIds);
            }),
        To<TagSubscriptionCommunicatorGetSubscriptionsRequest>(
            kSubscription, "{}",
            [] { return TagSubscriptionCommunicatorGetSubscriptionsRequest(); }),
        To<TagSubscriptionCommunicatorGetSubscriptionsResponse>(
            kReply, R"({"subscriptionIds":)" + kIdsJson + "}",
            [](Request r) { return TagSubscriptionCommunicatorGetSubscriptionsResponse(r, kIds); }),
        To<TagSubscriptionCommunicatorGetUpdatesRequest>(
            kSubscription, R"({"subscriptionIds":)" + kIdsJson + "}",
            [] { return TagSubscriptionCommunicatorGetUpdatesRequest(kIds); }),
        To<TagSubscriptionCommunicatorGetUpdatesResponse>(
            kReply, R"({"updates":)" + updatesJson + R"(,"invalidSubscriptionIds":[]})",
            [](Request r) {
                return TagSubscriptionCommunicatorGetUpdatesResponse(
                    r, std::vector<Update>{SampleSubscriptionUpdate()}, JsonStringList{});
            }),
        To<TagSubscriptionCommunicatorPushedUpdateRoutedMessage>(
            kReply, R"({"updates":)" + updatesJson + "}",
            [](Request r) {
                return TagSubscriptionCommunicatorPushedUpdateRoutedMessage(
                    r, std::vector<Update>{SampleSubscriptionUpdate()});
            }),
        To<TagSubscriptionCommunicatorSubscribeRequest>(
            kSubscription, R"({"alias":"","options":)" + kOptionsJson + R"(,"tags":["a.b"]})",
            [] {
                return TagSubscriptionCommunicatorSubscribeRequest(std::string(), SampleOptions(),
                                                                   JsonStringList{"a.b"});
            }),
        To<TagSubscriptionCommunicatorSubscribeResponse>(
            kReply, R"({"subscriptionId":"s1","alias":"al","nonexistentTags":)" + kIdsJson + "}",
            [](Request r) {
                return TagSubscriptionCommunicatorSubscribeResponse(r, std::string("s1"),
                                                                    std::string("al"), kIds);
            }),
        To<TagSubscriptionCommunicatorSubscriptionHeartbeatRequest>(
            kSubscription, R"({"subscriptionIds":)" + kIdsJson + "}",
            [] { return TagSubscriptionCommunicatorSubscriptionHeartbeatRequest(kIds); }),
        To<TagSubscriptionCommunicatorSubscriptionHeartbeatResponse>(
            kReply, R"({"invalidSubscriptionIds":)" + kIdsJson + "}",
            [](Request r) {
                return TagSubscriptionCommunicatorSubscriptionHeartbeatResponse(r, kIds);
            }),
        To<TagSubscriptionCommunicatorUnsubscribeRequest>(
            kSubscription, R"({"subscriptionIds":)" + kIdsJson + "}",
            [] { return TagSubscriptionCommunicatorUnsubscribeRequest(kIds); }),
        To<TagSubscriptionCommunicatorUnsubscribeResponse>(
            kReply, R"({"invalidSubscriptionIds":)" + kIdsJson + "}",
            [](Request r) { return TagSubscriptionCommunicatorUnsubscribeResponse(r, kIds); }),
        To<TagHttpCreateSelectionRequest>(
            kHttp, R"({"selection":)" + kSelectionJson + "}",
            [] { return TagHttpCreateSelectionRequest(SampleSelection()); }),
        To<TagHttpCreateSelectionResponse>(
            kReply, R"({"id":"sel1"})",
            [](Request r) { return TagHttpCreateSelectionResponse(r, std::string("sel1")); }),
        To<TagHttpDeleteSelectionRoutedMessage>(
            kHttp, R"({"id":"sel1"})",
            [] { return TagHttpDeleteSelectionRoutedMessage(std::string("sel1")); }),
        To<TagHttpGetSelectionRequest>(
            kHttp, R"({"id":"sel1"})",
            [] { return TagHttpGetSelectionRequest(std::string("sel1")); }),
        To<TagHttpGetSelectionResponse>(
            kReply, R"({"selection":)" + kSelectionJson + "}",
            [](Request r) { return TagHttpGetSelectionResponse(r, SampleSelection()); }),
        To<TagHttpGetSelectionsRequest>(kHttp, "{}", [] { return TagHttpGetSelectionsRequest(); }),
        To<TagHttpGetSelectionsResponse>(
            kReply, R"({"selections":[)" + kSelectionJson + "," + kSelectionJson + "]}",
            [](Request r) {
                return TagHttpGetSelectionsResponse(
                    r, std::vector{SampleSelection(), SampleSelection()});
            }),
        To<TagHttpUpdateSelectionRoutedMessage>(
            kHttp, R"({"selection":)" + kSelectionJson + "}",
            [] { return TagHttpUpdateSelectionRoutedMessage(SampleSelection()); }),
    };
}

const auto kCaseName = [](const auto& info) { return info.param.name; };

INSTANTIATE_TEST_SUITE_P(HistorianMessages, MessageClassTest, ::testing::ValuesIn(HistorianCases()),
                         kCaseName);
INSTANTIATE_TEST_SUITE_P(HistorianMessages, MessageResponseTest,
                         ::testing::ValuesIn(ResponsesOf(HistorianCases())), kCaseName);
INSTANTIATE_TEST_SUITE_P(SubscriptionAndSelectionMessages, MessageClassTest,
                         ::testing::ValuesIn(SubscriptionAndSelectionCases()), kCaseName);
INSTANTIATE_TEST_SUITE_P(SubscriptionAndSelectionMessages, MessageResponseTest,
                         ::testing::ValuesIn(ResponsesOf(SubscriptionAndSelectionCases())),
                         kCaseName);

}  // namespace
}  // namespace Korvane::Veldra::MessageBus::Testing
