#include <gtest/gtest.h>

#include "messagelibrary/taginfo/TagInfoQueryTagsResponse.h"
#include "requests/RequestTestSupport.h"
#include "taglibrary/Client.h"
#include "taglibrary/requests/AsyncRequestFactories.h"

// The Client's start and finish logic on a Client without a bus: requests are
// filed and completed by hand, as the bus thread would.
namespace Korvane::Veldra::TagLibrary::Testing {
namespace {

using VeldraMessageLibrary::TagRecord;

class ClientFinishTest : public ::testing::Test {
protected:
    // Files a request completed with the reply, as after a send and its answer.
    uint32_t Replied(std::shared_ptr<GenericMessage> reply) {
        const auto request = MakeConsoleAsyncRequest();
        const uint32_t id = client.RequestMap()->Add(request);
        request->Complete(std::move(reply));
        return id;
    }
    // A lookup answered with records of the given types for the path.
    uint32_t LookupFound(const std::vector<TagDataType>& types) {
        std::vector<TagRecord> records;
        for (const TagDataType type : types) {
            TagRecord record;
            record.path = "line/speed";
            record.type = type;
            records.push_back(record);
        }
        const auto request = Reply("TagInfoQueryTagsRequest");
        VeldraMessageLibrary::TagInfoMessages::TagInfoQueryTagsResponse response(
            *request, records, static_cast<int32_t>(records.size()));
        return Replied(std::make_shared<GenericMessage>(response.Headers(), response.Serialize()));
    }
    int32_t Open(uint32_t& id, std::optional<TagDataType> wanted) {
        found = false;
        tag.reset();
        uint32_t timeoutMs = 0;
        return client.OpenOrCreateTag(4, "line/speed", wanted, MakeConsoleAsyncRequest(), found,
                                      tag, id, timeoutMs, error);
    }

    Client client{Client::LocalOnly{}, "veldra_master", 5000, true, false, InitializedErrors()};
    std::string error;
    bool found = false;
    std::shared_ptr<TagData> tag;
};

TEST_F(ClientFinishTest, AFinishTakesTheRequestOutOnce) {
    const uint32_t id = Replied(Reply("GenericResponse"));
    EXPECT_EQ(client.FinishRequest(id, error), 0);
    EXPECT_EQ(client.FinishRequest(id, error), -251914);
    EXPECT_EQ(error, "Invalid state.");
    EXPECT_EQ(client.FinishRequest(777, error), -251914);
}

TEST_F(ClientFinishTest, NoReplyIsATimeOutAndAnErrorReplyIsItsError) {
    const uint32_t pending = client.RequestMap()->Add(MakeConsoleAsyncRequest());
    EXPECT_EQ(client.FinishRequest(pending, error), -251001);
    EXPECT_EQ(error, "Request timed out.");
    std::shared_ptr<AsyncRequest> request;
    const uint32_t failed = Replied(ErrorReply("Tag.NoSuchTag", {"x"}));
    EXPECT_EQ(client.TakeFinishedRequest(failed, request, error), -251909);
    EXPECT_EQ(error, "No such tag: 'x'.");
    EXPECT_NE(request, nullptr);
    EXPECT_EQ(client.RequestMap()->Size(), 0u);
}

TEST_F(ClientFinishTest, BadPathsAreRefusedBeforeAnythingIsFiled) {
    uint32_t id = 0, timeoutMs = 0;
    for (const std::string path : {"", "*", "line/*", "a*b"}) {
        EXPECT_EQ(client.OpenTag(path, MakeConsoleAsyncRequest(), id, timeoutMs, error), -251904)
            << path;
        EXPECT_EQ(error, "Invalid tag path.");
    }
    EXPECT_EQ(client.RequestMap()->Size(), 0u);
    EXPECT_EQ(id, 0u);

    client.SetVerbose(true);
    testing::internal::CaptureStdout();
    client.OpenTag("a*", MakeConsoleAsyncRequest(), id, timeoutMs, error);
    EXPECT_EQ(testing::internal::GetCapturedStdout(), "Opening tag path: a*\n");
}

TEST_F(ClientFinishTest, ALookupOfTheWantedTypeMapsTheTag) {
    uint32_t id = LookupFound({TagDataType::Double});
    ASSERT_EQ(Open(id, TagDataType::Double), 0);
    EXPECT_TRUE(found);
    ASSERT_NE(tag, nullptr);
    EXPECT_EQ(tag->path, "line/speed");
    EXPECT_EQ(tag->instanceId, 4u);
    EXPECT_EQ(client.OpenTagCount(), 1u);
}

TEST_F(ClientFinishTest, ALookupOfAnotherTypeIsAConflict) {
    uint32_t id = LookupFound({TagDataType::Double});
    EXPECT_EQ(Open(id, TagDataType::Int), -251907);
    EXPECT_TRUE(found);
    EXPECT_EQ(error, "Conflicting types for tag 'line/speed': 'Int' != 'Double'.");
    id = LookupFound({TagDataType::Double});
    EXPECT_EQ(Open(id, TagDataType::UInt64), -251907);
    EXPECT_EQ(error, "Conflicting types for tag 'line/speed': 'none' != 'Double'.");
    // The exported number 6 is a present None, unlike any server type.
    id = LookupFound({TagDataType::Double});
    EXPECT_EQ(Open(id, TagDataType::None), -251907);
    EXPECT_EQ(client.OpenTagCount(), 0u);
}

TEST_F(ClientFinishTest, NoRecordOrSeveralLeadToACreate) {
    for (const auto& types : {std::vector<TagDataType>{},
                              std::vector<TagDataType>{TagDataType::Int, TagDataType::Int}}) {
        uint32_t id = LookupFound(types);
        const uint32_t lookupId = id;
        // Without a bus the create cannot leave; that it was tried shows in
        // the new id and the status of the send.
        EXPECT_EQ(Open(id, TagDataType::Int), -251914);
        EXPECT_FALSE(found);
        EXPECT_NE(id, lookupId);
        EXPECT_EQ(client.RequestMap()->Size(), 0u);
    }
}

TEST_F(ClientFinishTest, AFinishedCreateMapsAndAFailedOneDoesNot) {
    EXPECT_EQ(client.FinishCreateTag(4, "new/tag", TagDataType::String,
                                     Replied(ErrorReply("Tag.TagAlreadyExists", {"new/tag"})), tag,
                                     error),
              -251910);
    EXPECT_EQ(tag, nullptr);
    ASSERT_EQ(client.FinishCreateTag(4, "new/tag", TagDataType::String,
                                     Replied(Reply("GenericResponse")), tag, error),
              0);
    ASSERT_NE(tag, nullptr);
    EXPECT_EQ(tag->dataType, TagDataType::String);
}

TEST_F(ClientFinishTest, AnUnreadableLookupReplyGoesUp) {
    uint32_t id = Replied(Reply("TagInfoQueryTagsResponse", "{not json"));
    EXPECT_ANY_THROW(Open(id, TagDataType::Int));
}

}  // namespace
}  // namespace Korvane::Veldra::TagLibrary::Testing
