// The service on the bus: each message class reaches its handler and is
// answered as the client expects, broadcasts go out, and bad bodies are
// answered without harm. The rules themselves are unit-tested.
#include <gtest/gtest.h>

#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsRequest.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "messagelibrary/taginfo/TagInfoCreateTagRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeleteTagsRoutedMessage.h"
#include "messagelibrary/taginfo/TagInfoDeletedTagsBroadcast.h"
#include "messagelibrary/taginfo/TagInfoTagMetadataUpdatedBroadcast.h"
#include "messagelibrary/taginfo/TagInfoUpdateTagRoutedMessage.h"
#include "messagelibrary/tagcurrentvalue/TagCvAggregatesResetBroadcast.h"
#include "messagelibrary/tagcurrentvalue/TagCvResetAggregatesRoutedMessage.h"
#include "messagelibrary/tagingestion/TagNewTagsIngestedBroadcast.h"
#include "tagservice/TagServiceClient.h"

namespace Korvane::Veldra::Testing {
namespace {

using Tags::TagDataType;
namespace Info = Tags::TagInfoMessages;
namespace Cv = Tags::TagCurrentValueMessages;
namespace Ingest = Tags::TagIngestionMessages;

// One service for the whole suite; each test works under its own paths.
class TagServiceWiringTest : public ::testing::Test {
protected:
    // The service is started by the first test, not in SetUpTestSuite: a
    // failure there would show every test as skipped, and ctest would pass
    // the run. Here each test fails while it is not up; it is tried once.
    void SetUp() override {
        if (!startAttempted) {
            startAttempted = true;
            TagServiceProcess::Options options;
            options.verbose = true;
            try {
                service = new TagServiceProcess(options);
            } catch (const std::exception& error) {
                ADD_FAILURE() << error.what();
            }
        }
        ASSERT_NE(service, nullptr) << "the tag service did not start (see the first test)";
    }
    static void TearDownTestSuite() {
        delete service;
        service = nullptr;
    }
    void TearDown() override {
        if (HasFailure() && service != nullptr) {
            std::cerr << "service output:\n" << service->Output();
        }
    }

    // A raw message of the type to a target, with the body as it stands.
    MessageBus::GenericMessage Raw(const std::string& target, const std::string& type,
                                   const std::string& body) {
        MessageBus::MessageHeaders headers;
        headers.messageType = type;
        headers.contentType = "application/json";
        headers.correlationId = UniqueQueueName("raw");
        headers.routingKey = "Veldra." + target + "." + type;
        return MessageBus::GenericMessage(headers, MessageBus::MessageBody(body));
    }

    static TagServiceProcess* service;
    static bool startAttempted;
    TagServiceClient client;
};
TagServiceProcess* TagServiceWiringTest::service = nullptr;
bool TagServiceWiringTest::startAttempted = false;

TEST_F(TagServiceWiringTest, CreateAnswersWithGenericResponseAndRefusesBadPathsInTheHeaders) {
    client.Listen(Info::TagInfoTagMetadataUpdatedBroadcast::kMessageName);
    client.Create("wiring.create.a", TagDataType::Double);
    EXPECT_NE(client.collector->WaitFor(Info::TagInfoTagMetadataUpdatedBroadcast::kMessageName,
                                        [](const auto& m) {
                                            return m.Body().ToString().find("wiring.create.a") !=
                                                   std::string::npos;
                                        }),
              nullptr);

    Tags::TagRecord starred{std::string("wiring.*"), TagDataType::Int, {}, {}, false};
    Info::TagInfoCreateTagRoutedMessage bad(starred);
    const MessagePtr reply = client.Routed(bad);
    ASSERT_NE(reply, nullptr);
    EXPECT_EQ(reply->MessageType(), "GenericResponse");
    EXPECT_EQ(ErrorName(*reply), "Tag.TagPathCannotContainAWildcard");

    Tags::TagRecord otherType{std::string("wiring.create.a"), TagDataType::Int, {}, {}, false};
    Info::TagInfoCreateTagRoutedMessage clash(otherType);
    const MessagePtr clashReply = client.Routed(clash);
    ASSERT_NE(clashReply, nullptr);
    EXPECT_EQ(ErrorName(*clashReply), "Tag.TagAlreadyExists");
    EXPECT_EQ(clashReply->GetError().args, std::vector<std::string>{"wiring.create.a"});

    const auto page = client.Query(Tags::JsonStringList{"wiring.create.a"});
    ASSERT_TRUE(page.Tags());
    ASSERT_EQ(page.Tags()->size(), 1u);
    EXPECT_EQ(page.Tags()->front().type, TagDataType::Double);
}

TEST_F(TagServiceWiringTest, QueryPagesThroughAWildcardWithTheTotalCount) {
    for (int i = 0; i < 25; ++i) {
        client.Create("wiring.page." + std::to_string(100 + i), TagDataType::Int);
    }
    const auto page = client.Query(Tags::JsonStringList{"wiring.page.*"}, 20, 10);
    EXPECT_EQ(page.TotalCount(), 25);
    ASSERT_TRUE(page.Tags());
    ASSERT_EQ(page.Tags()->size(), 5u);
    EXPECT_EQ(page.Tags()->front().path, "wiring.page.120");
}

TEST_F(TagServiceWiringTest, MetadataFailuresTravelInTheBodyWithCleanHeaders) {
    client.Create("wiring.meta.s", TagDataType::String);
    client.Create("wiring.meta.d", TagDataType::Double);
    Tags::TagRecord collect{std::string("wiring.meta.s"), TagDataType::String, {}, {}, true};
    Tags::TagRecord keywords{std::string("wiring.meta.d"), TagDataType::Double, {},
                             Tags::JsonStringList{"k1"}, false};
    Tags::TagRecord unknown{std::string("wiring.meta.none"), TagDataType::Double, {}, {}, false};
    Info::TagInfoCreateOrUpdateTagsRequest request(
        std::vector<Tags::TagChange>{{collect, Tags::TagChangeFlags::CollectAggregates},
                                     {keywords, Tags::TagChangeFlags::Keywords},
                                     {unknown, Tags::TagChangeFlags::Keywords}},
        true);
    const MessagePtr reply = client.Request(request);
    ASSERT_NE(reply, nullptr);
    EXPECT_EQ(ErrorName(*reply), "");
    Info::TagInfoCreateOrUpdateTagsResponse response(reply->Headers(), reply->Body());
    ASSERT_TRUE(response.Errors());
    EXPECT_EQ(response.Errors()->name, "Veldra.OneOrMoreErrorsOccurred");
    ASSERT_TRUE(response.Errors()->innerErrors);
    ASSERT_EQ(response.Errors()->innerErrors->size(), 2u);
    EXPECT_EQ(response.Errors()->innerErrors->at(0).name, "Tag.StringTagCannotCollectAggregates");
    EXPECT_EQ(response.Errors()->innerErrors->at(0).resourceId, "wiring.meta.s");
    EXPECT_EQ(response.Errors()->innerErrors->at(1).name, "Tag.NoSuchTag");

    const auto page = client.Query(Tags::JsonStringList{"wiring.meta.d"});
    ASSERT_TRUE(page.Tags() && page.Tags()->size() == 1u);
    EXPECT_EQ(page.Tags()->front().keywords, Tags::JsonStringList{"k1"});

    Info::TagInfoUpdateTagRoutedMessage update(std::string("wiring.meta.nothere"), std::nullopt,
                                               std::nullopt, std::nullopt, false);
    const MessagePtr updateReply = client.Routed(update);
    ASSERT_NE(updateReply, nullptr);
    EXPECT_EQ(ErrorName(*updateReply), "Tag.NoSuchTag");
}

TEST_F(TagServiceWiringTest, WritesBecomeCurrentValuesWithAggregatesAndBroadcasts) {
    client.Listen(Ingest::TagNewTagsIngestedBroadcast::kMessageName);
    client.Listen(Cv::TagCvAggregatesResetBroadcast::kMessageName);
    client.Create("wiring.values.d", TagDataType::Double, true);
    client.Create("wiring.values.never", TagDataType::Int);
    const auto at = Tags::Timestamp(boost::gregorian::date(2016, 3, 1),
                                    boost::posix_time::hours(12));
    EXPECT_EQ(client.Write("wiring.values.d", {Sample(TagDataType::Double, "1.5", at),
                                               Sample(TagDataType::Double, "2.5", at)}),
              "");
    EXPECT_EQ(client.Write("wiring.values.d", {Sample(TagDataType::Double, "abc")}),
              "Tag.InvalidTagValue");
    EXPECT_EQ(client.Write("wiring.values.unknown", {Sample(TagDataType::Double, "1")}),
              "Tag.NoSuchTag");
    EXPECT_NE(client.collector->WaitFor(Ingest::TagNewTagsIngestedBroadcast::kMessageName,
                                        [](const auto& m) {
                                            return m.Body().ToString().find("wiring.values.d") !=
                                                   std::string::npos;
                                        }),
              nullptr);

    const auto values =
        client.Read({"wiring.values.never", "wiring.values.unknown", "wiring.values.d"});
    ASSERT_EQ(values.size(), 2u);
    EXPECT_EQ(values[0].path, "wiring.values.never");
    EXPECT_FALSE(values[0].current);
    EXPECT_FALSE(values[0].aggregates);
    ASSERT_TRUE(values[1].current && values[1].current->value);
    EXPECT_EQ(values[1].current->value->value, "2.5");
    EXPECT_EQ(values[1].current->timestamp, at);
    ASSERT_TRUE(values[1].aggregates);
    EXPECT_EQ(values[1].aggregates->count, 2);
    EXPECT_DOUBLE_EQ(values[1].aggregates->avg, 2.0);

    Cv::TagCvResetAggregatesRoutedMessage reset(Tags::JsonStringList{"wiring.values.d"});
    const MessagePtr resetReply = client.Routed(reset);
    ASSERT_NE(resetReply, nullptr);
    EXPECT_EQ(ErrorName(*resetReply), "");
    EXPECT_NE(client.collector->WaitFor(Cv::TagCvAggregatesResetBroadcast::kMessageName,
                                        [](const auto&) { return true; }),
              nullptr);
    EXPECT_EQ(client.Read({"wiring.values.d"}).at(0).aggregates->count, 0);
}

TEST_F(TagServiceWiringTest, DeleteRemovesMatchingTagsAndBroadcastsThem) {
    client.Listen(Info::TagInfoDeletedTagsBroadcast::kMessageName);
    client.Create("wiring.delete.a", TagDataType::Int);
    client.Create("wiring.delete.b", TagDataType::Int);
    client.Create("wiring.keep", TagDataType::Int);
    Info::TagInfoDeleteTagsRoutedMessage remove(Tags::JsonStringList{"wiring.delete.*"});
    const MessagePtr reply = client.Routed(remove);
    ASSERT_NE(reply, nullptr);
    EXPECT_EQ(ErrorName(*reply), "");
    const MessagePtr broadcast = client.collector->WaitFor(
        Info::TagInfoDeletedTagsBroadcast::kMessageName, [](const auto&) { return true; });
    ASSERT_NE(broadcast, nullptr);
    Info::TagInfoDeletedTagsBroadcast deleted(broadcast->Headers(), broadcast->Body());
    EXPECT_EQ(deleted.Tags(), (Tags::JsonStringList{"wiring.delete.a", "wiring.delete.b"}));
    EXPECT_EQ(client.Query(Tags::JsonStringList{"wiring.delete.*"}).TotalCount(), 0);
    EXPECT_EQ(client.Query(Tags::JsonStringList{"wiring.keep"}).TotalCount(), 1);
}

TEST_F(TagServiceWiringTest, IgnoreResponseIsHonouredAndTheNextMessageStillAnswered) {
    Tags::TagRecord record{std::string("wiring.ignored"), TagDataType::Int, {}, {}, false};
    Info::TagInfoCreateTagRoutedMessage quiet(record);
    client.Service().SendRouted(quiet, true);
    // Messages are handled in order: once this reply is here, the quiet one
    // was handled, and any answer to it would have come first.
    const auto page = client.Query(Tags::JsonStringList{"wiring.ignored"});
    EXPECT_EQ(page.TotalCount(), 1);
    EXPECT_EQ(client.collector->WaitFor("GenericResponse",
                                        [&](const auto& m) {
                                            return m.CorrelationId() == quiet.CorrelationId();
                                        },
                                        std::chrono::milliseconds(0)),
              nullptr);
}

TEST_F(TagServiceWiringTest, BodiesThatDoNotParseAreAnsweredWithFailedToParse) {
    const MessagePtr query =
        client.Service().SendRequest(Raw("TagInfo", "TagInfoQueryTagsRequest", "{\"skip\":"),
                                     kReplyTimeoutMs);
    ASSERT_NE(query, nullptr);
    EXPECT_EQ(query->MessageType(), "TagInfoQueryTagsResponse");
    EXPECT_EQ(ErrorName(*query), "Veldra.FailedToParse");

    auto routed = Raw("TagIngestion", "TagUpdateValuesRoutedMessage",
                      "{\"updates\":[{\"path\":\"a\",\"updates\":\"not a list\"}]}");
    const MessagePtr write = client.Service().SendRequestExpectingResponse(routed, kReplyTimeoutMs);
    ASSERT_NE(write, nullptr);
    EXPECT_EQ(write->MessageType(), "GenericResponse");
    EXPECT_EQ(ErrorName(*write), "Veldra.FailedToParse");

    const MessagePtr binary = client.Service().SendRequest(
        Raw("TagCurrentValue", "TagCvQueryCurrentValuesByPathRequest", std::string("\0\xff{", 3)),
        kReplyTimeoutMs);
    ASSERT_NE(binary, nullptr);
    EXPECT_EQ(ErrorName(*binary), "Veldra.FailedToParse");

    EXPECT_EQ(client.Query(Tags::JsonStringList{"nothing.here"}).TotalCount(), 0);
    EXPECT_TRUE(service->WaitForOutput("cannot parse TagInfoQueryTagsRequest",
                                       std::chrono::seconds(5)));
}

TEST_F(TagServiceWiringTest, AMessageOfAnUnknownNameIsAnsweredWithNotSupported) {
    const MessagePtr request = client.Service().SendRequest(
        Raw("TagInfo", "TagInfoRenameTagRequest", "{}"), kReplyTimeoutMs);
    ASSERT_NE(request, nullptr);
    EXPECT_EQ(ErrorName(*request), "Veldra.NotSupported");
    auto routed = Raw("TagIngestion", "TagPurgeRoutedMessage", "{}");
    const MessagePtr reply = client.Service().SendRequestExpectingResponse(routed, kReplyTimeoutMs);
    ASSERT_NE(reply, nullptr);
    EXPECT_EQ(ErrorName(*reply), "Veldra.NotSupported");
}

TEST_F(TagServiceWiringTest, VerbosePrintsOneLinePerMessage) {
    client.Query(Tags::JsonStringList{"wiring.verbose"});
    EXPECT_TRUE(service->WaitForOutput("TagInfoQueryTagsRequest from " + client.Service().Name() +
                                           ": ok",
                                       std::chrono::seconds(5)));
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
