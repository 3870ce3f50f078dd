#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "messagelibrary/MessageBodyChecks.h"
#include "messagelibrary/RequestMessage.h"
#include "messagelibrary/historian/HistorianSamples.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryCompleteRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryDataRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncQueryRequest.h"
#include "messagelibrary/taghistorian/TagHistorianAsyncValuesProcessedRoutedMessage.h"
#include "messagelibrary/taghistorian/TagHistorianDeleteValuesByIdRequest.h"
#include "messagelibrary/taghistorian/TagHistorianQueryRequest.h"
#include "messagelibrary/taghistorian/TagHistorianQueryResponse.h"
#include "messagelibrary/taghistorian/TagHistorianUpdateValuesResponse.h"
#include "messagelibrary/taghttp/TagHttpGetSelectionsResponse.h"
#include "messagelibrary/taghttp/TagHttpUpdateSelectionRoutedMessage.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetSubscriptionResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorGetUpdatesResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorMessageWrapperRequest.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorMessageWrapperResponse.h"
#include "messagelibrary/tagsubscription/TagSubscriptionCommunicatorPushedUpdateRoutedMessage.h"
#include "support/CatchVeldra.h"

namespace Korvane::Veldra::VeldraMessageLibrary {
namespace {

using Testing::ExpectRefusals;
using Testing::Parse;
using Testing::Written;
using namespace TagHistorianMessages;
using namespace TagSubscriptionCommunicatorMessages;
using namespace TagHttpMessages;
using MessageBus::MessageBody;

class Query : public MessageBus::RequestMessage {
public:
    Query() : RequestMessage("Query", "application/json", "Somewhere") { SetReplyTo("client_q"); }
    MessageBody Serialize() const override { return MessageBody("{}"); }
};

TEST(HistorianMessages, EmptyAndUnsetValueMapsAndUnsetTimesAreWrittenAsTheyShould) {
    const Query query;
    const auto response = [&](std::optional<HistorianValueMap> values) {
        return Written(TagHistorianQueryResponse(
            query, HistorianValues{std::move(values), 0, std::nullopt, std::nullopt}));
    };
    EXPECT_EQ(response(HistorianValueMap{}),
              R"({"tagHistorianValues":{"values":{},"totalCount":0,"errors":null,"failed":null}})");
    EXPECT_EQ(response(std::nullopt),
              R"({"tagHistorianValues":{"values":null,"totalCount":0,"errors":null,)"
              R"("failed":null}})");

    const std::string unsetQuery =
        R"({"queries":[{"paths":null,"startTime":"0001-01-01T00:00:00","endTime":)"
        R"("0001-01-01T00:00:00","skip":0,"take":0,"decimation":0,"sortOrder":null}]})";
    EXPECT_EQ(Written(TagHistorianAsyncQueryRequest(std::vector{HistorianQuery{}})), unsetQuery);
    const auto parsed = Parse<TagHistorianAsyncQueryRequest>(unsetQuery);
    EXPECT_TRUE(parsed.Queries()->at(0).startTime.is_not_a_date_time());
    EXPECT_TRUE(Parse<TagHistorianQueryRequest>("{}").EndTime().is_not_a_date_time());
}

TEST(HistorianMessages, ValueMapsAreReadByPath) {
    const auto values = Parse<TagHistorianQueryResponse>(
                            R"({"tagHistorianValues":{"values":{"b":[{"id":"2"}],"a":null}}})")
                            .TagHistorianValues()
                            ->values;
    ASSERT_TRUE(values.has_value());
    ASSERT_EQ(values->size(), 2u);
    EXPECT_TRUE(values->at("a").empty());
    EXPECT_EQ(values->at("b").at(0).id, "2");
}

TEST(HistorianMessages, RefusedFieldsNameTheKeyWithTheCodeOfItsType) {
    const auto query = Parse<TagHistorianQueryRequest>;
    const auto values = Parse<TagHistorianQueryResponse>;
    const auto subscription = Parse<TagSubscriptionCommunicatorGetSubscriptionResponse>;
    ExpectRefusals({
        {query, R"({"startTime":"yesterday"})", -251005, "startTime"},
        {query, R"({"endTime":null})", -251005, "endTime"},
        {query, R"({"decimation":1e10})", -251005, "decimation"},
        {query, R"({"sortOrder":"descending"})", -251004, "sortOrder"},
        {Parse<TagHistorianAsyncQueryRequest>, R"({"queries":[{"sortOrder":"UP"}]})", -251005,
         "queries"},
        {Parse<TagHistorianDeleteValuesByIdRequest>, R"({"ids":"i1"})", -251005, "ids"},
        {values, R"({"tagHistorianValues":{"values":[]}})", -251004, "tagHistorianValues"},
        {values, R"({"tagHistorianValues":{"values":{"a":{}}}})", -251004, "tagHistorianValues"},
        {values, R"({"tagHistorianValues":{"values":{"a":[{"type":"BOOL"}]}}})", -251004,
         "tagHistorianValues"},
        {Parse<TagHistorianAsyncQueryDataRoutedMessage>,
         R"({"tagHistorianAsyncValues":{"errors":{"args":"a"}}})", -251004,
         "tagHistorianAsyncValues"},
        {Parse<TagHistorianUpdateValuesResponse>, R"({"errors":[]})", -251004, "errors"},
        {subscription, R"({"validSubscription":1})", -251005, "validSubscription"},
        {subscription, R"({"options":{"updateMode":"PUSH"}})", -251004, "options"},
        {subscription, R"({"options":{"batchIntervalSeconds":[]}})", -251004, "options"},
        {Parse<TagSubscriptionCommunicatorGetUpdatesResponse>,
         R"({"updates":[{"updates":[{"tag":{"type":"BOOL"}}]}]})", -251005, "updates"},
        {Parse<TagHttpUpdateSelectionRoutedMessage>, R"({"selection":[]})", -251004, "selection"},
        {Parse<TagHttpGetSelectionsResponse>, R"({"selections":[{"inactivityTimeout":true}]})",
         -251005, "selections"},
    });
}

TEST(HistorianMessages, RoutedAnswersGoToTheReplyQueueWithTheirOwnCorrelation) {
    const Query query;
    const std::vector<std::shared_ptr<MessageBus::MessageBase>> sent = {
        std::make_shared<TagHistorianAsyncQueryCompleteRoutedMessage>(query, std::nullopt),
        std::make_shared<TagHistorianAsyncQueryDataRoutedMessage>(query, std::nullopt),
        std::make_shared<TagHistorianAsyncValuesProcessedRoutedMessage>(query, std::nullopt),
        std::make_shared<TagSubscriptionCommunicatorPushedUpdateRoutedMessage>(query, std::nullopt),
    };
    for (const auto& message : sent) {
        SCOPED_TRACE(message->MessageType());
        EXPECT_EQ(message->RoutingKey(), "Veldra.client_q." + message->MessageType());
        EXPECT_EQ(message->CorrelationId(), message->MessageId());
        EXPECT_NE(message->CorrelationId(), query.CorrelationId());
        EXPECT_TRUE(message->IgnoreResponse());
    }
}

TEST(SubscriptionMessages, WrappersCarryAnyBodyUntouched) {
    const Query query;
    for (const std::string& body : {std::string(R"({"x":[1, 2]})"), std::string("not json {"),
                                    std::string("a\0b", 3), std::string()}) {
        SCOPED_TRACE(body);
        const TagSubscriptionCommunicatorMessageWrapperRequest request{MessageBody(body)};
        EXPECT_EQ(
            request.RoutingKey(),
            "Veldra.TagSubscriptionCommunicator.TagSubscriptionCommunicatorMessageWrapperRequest");
        EXPECT_EQ(Written(request), body);
        EXPECT_EQ(Written(Parse<TagSubscriptionCommunicatorMessageWrapperRequest>(body)), body);

        const TagSubscriptionCommunicatorMessageWrapperResponse response(query, MessageBody(body));
        EXPECT_EQ(response.RoutingKey(),
                  "Veldra.client_q.TagSubscriptionCommunicatorMessageWrapperResponse");
        EXPECT_EQ(response.CorrelationId(), query.CorrelationId());
        EXPECT_EQ(Written(response), body);
        EXPECT_EQ(Written(Parse<TagSubscriptionCommunicatorMessageWrapperResponse>(body)), body);
    }
    const TagSubscriptionCommunicatorMessageWrapperResponse failed(
        query, MessageBus::MessageError::Named("Tag.NoSuchTag"));
    EXPECT_TRUE(failed.HasError());
    EXPECT_TRUE(failed.Serialize().Empty());
}

}  // namespace
}  // namespace Korvane::Veldra::VeldraMessageLibrary
