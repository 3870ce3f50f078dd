#include <gtest/gtest.h>

#include <thread>

#include "RequestTestSupport.h"
#include "WBHostRuntime.h"
#include "messagelibrary/ErrorRecord.h"
#include "messagelibrary/taginfo/TagInfoCreateOrUpdateTagsResponse.h"
#include "taglibrary/requests/AsyncRequestFactories.h"
#include "taglibrary/requests/AsyncRequestWithError.h"
#include "taglibrary/requests/AsyncUpdateRequest.h"
#include "taglibrary/requests/ConsoleAsyncRequest.h"
#include "taglibrary/requests/WBAsyncRequest.h"

namespace Korvane::Veldra::TagLibrary::Testing {
namespace {

using VeldraMessageLibrary::ErrorRecord;

class AsyncRequestTest : public ::testing::Test {
protected:
    int32_t Check(AsyncRequest& request) { return request.CheckResult(*errors, text); }

    // A create-or-update reply whose body carries the record.
    static std::shared_ptr<GenericMessage> UpdateReply(std::optional<ErrorRecord> record) {
        const auto request = Reply("TagInfoCreateOrUpdateTagsRequest");
        VeldraMessageLibrary::TagInfoMessages::TagInfoCreateOrUpdateTagsResponse response(
            *request, std::move(record));
        return std::make_shared<GenericMessage>(response.Headers(), response.Serialize());
    }
    static ErrorRecord Named(const std::string& name) {
        ErrorRecord record;
        record.name = name;
        record.args = VeldraMessageLibrary::JsonStringList{"ignored"};
        return record;
    }

    std::shared_ptr<TagIngestion::Errors> errors = InitializedErrors();
    std::string text;
};

TEST_F(AsyncRequestTest, TheReplyDecides) {
    ConsoleAsyncRequest request;
    EXPECT_EQ(Check(request), -251001);
    EXPECT_EQ(text, "Request timed out.");

    request.Complete(ErrorReply("Tag.NoSuchTag", {"line/speed"}));
    EXPECT_EQ(Check(request), -251909);
    EXPECT_EQ(text, "No such tag: 'line/speed'.");

    text.clear();
    request.Complete(Reply("GenericResponse"));
    EXPECT_EQ(Check(request), 0);
    EXPECT_EQ(text, "");
}

TEST_F(AsyncRequestTest, AConsoleRequestCompletedEarlyNeverBlocks) {
    ConsoleAsyncRequest request;
    request.Complete(Reply("GenericResponse"));
    // Manual reset: every wait sees the completion, however often it waits.
    for (int i = 0; i < 3; ++i) request.Wait(CompletionEvent::kInfinite);
    EXPECT_NE(request.Response(), nullptr);
}

TEST_F(AsyncRequestTest, AConsoleWaitEndsWhenTheReplyComes) {
    auto request = std::make_shared<ConsoleAsyncRequest>();
    std::thread bus([request] { request->Complete(Reply("GenericResponse")); });
    request->Wait(CompletionEvent::kInfinite);
    bus.join();
    EXPECT_EQ(Check(*request), 0);
}

TEST(CompletionEventTest, AutoResetAndZeroTimeout) {
    CompletionEvent automatic(false, false);
    EXPECT_FALSE(automatic.Wait(0));
    EXPECT_FALSE(automatic.Wait(1));
    automatic.Set();
    EXPECT_TRUE(automatic.Wait(0));
    EXPECT_FALSE(automatic.Wait(0));  // the wait that saw it cleared it

    CompletionEvent manual(true, true);
    EXPECT_TRUE(manual.Wait(0));
    EXPECT_TRUE(manual.Wait(10));
}

TEST_F(AsyncRequestTest, ALocalErrorGoesBeforeTheReplyAndTheTimeOut) {
    const auto inner = MakeConsoleAsyncRequest();
    const auto withError = MakeAsyncRequestWithError(inner, -251900, "Invalid tag reference.");
    EXPECT_EQ(Check(*withError), -251900);  // no reply yet
    EXPECT_EQ(text, "Invalid tag reference.");
    EXPECT_TRUE(withError->Complete(ErrorReply("Tag.InvalidState")));
    EXPECT_EQ(Check(*withError), -251900);
    // Both hold the reply: the map's object and the one the caller waits on.
    EXPECT_NE(withError->Response(), nullptr);
    EXPECT_EQ(inner->Response(), withError->Response());

    const auto clean = MakeAsyncRequestWithError(MakeConsoleAsyncRequest(), 0, "unused");
    EXPECT_EQ(Check(*clean), -251001);
    clean->Complete(Reply("GenericResponse"));
    EXPECT_EQ(Check(*clean), 0);
}

TEST_F(AsyncRequestTest, AnUpdateReportsTheFirstInnerErrorWithoutInserts) {
    ErrorRecord top;
    top.innerErrors = std::vector<ErrorRecord>{Named("Tag.NoSuchTag"), Named("Tag.InvalidState")};
    AsyncUpdateRequest update(MakeConsoleAsyncRequest());
    update.Complete(UpdateReply(top));
    EXPECT_EQ(Check(update), -251909);
    EXPECT_EQ(text, errors->messageForName("Tag.NoSuchTag"));
}

TEST_F(AsyncRequestTest, AnUpdateWithoutInnerErrorsSucceedsAndAnEmptyListDoesNot) {
    AsyncUpdateRequest noErrors(MakeConsoleAsyncRequest());
    noErrors.Complete(UpdateReply(std::nullopt));
    EXPECT_EQ(Check(noErrors), 0);

    AsyncUpdateRequest topOnly(MakeConsoleAsyncRequest());
    topOnly.Complete(UpdateReply(Named("Tag.NoSuchTag")));
    EXPECT_EQ(Check(topOnly), 0);

    ErrorRecord empty;
    empty.innerErrors = std::vector<ErrorRecord>{};
    AsyncUpdateRequest emptyList(MakeConsoleAsyncRequest());
    emptyList.Complete(UpdateReply(empty));
    EXPECT_EQ(Check(emptyList), -251914);
}

TEST_F(AsyncRequestTest, AnUpdateWithAHeaderErrorNeverReadsTheBody) {
    AsyncUpdateRequest update(MakeConsoleAsyncRequest());
    update.Complete(Reply("GenericResponse", "not json",
                          MessageBus::MessageError::Named("Tag.InvalidState")));
    EXPECT_EQ(Check(update), -251914);

    AsyncUpdateRequest unreadable(MakeConsoleAsyncRequest());
    unreadable.Complete(Reply("TagInfoCreateOrUpdateTagsResponse", "not json"));
    EXPECT_ANY_THROW(Check(unreadable));
}

TEST_F(AsyncRequestTest, AHostRequestFiresItsSignal) {
    uint32_t signal = 0;
    const auto request = MakeWBAsyncRequest(signal);
    EXPECT_NE(signal, 0u);
    EXPECT_EQ(WBWaitSignal(signal, 0), 0);
    EXPECT_TRUE(request->Complete(Reply("GenericResponse")));
    EXPECT_EQ(WBWaitSignal(signal, 0), 1);

    // A signal that the host gave up cannot be fired.
    uint32_t abandoned = 0;
    const auto orphan = MakeWBAsyncRequest(abandoned);
    ASSERT_EQ(WBFreeSignal(abandoned), 0);
    EXPECT_FALSE(orphan->Complete(Reply("GenericResponse")));
}

}  // namespace
}  // namespace Korvane::Veldra::TagLibrary::Testing
