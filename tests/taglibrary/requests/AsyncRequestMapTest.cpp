#include <gtest/gtest.h>

#include <atomic>
#include <thread>
#include <vector>

#include "RequestTestSupport.h"
#include "WBHostRuntime.h"
#include "taglibrary/requests/AsyncRequestFactories.h"
#include "taglibrary/requests/AsyncRequestMap.h"
#include "taglibrary/requests/AsyncResponseCallbacks.h"

namespace Korvane::Veldra::TagLibrary::Testing {
namespace {

TEST(AsyncRequestMapTest, IdsStartAtOneAndSkipZeroOnTheWrap) {
    AsyncRequestMap fresh;
    EXPECT_EQ(fresh.Add(MakeConsoleAsyncRequest()), 1u);
    EXPECT_EQ(fresh.Add(MakeConsoleAsyncRequest()), 2u);

    AsyncRequestMap nearTheEnd(0xFFFFFFFEu);
    const auto survivor = MakeConsoleAsyncRequest();
    EXPECT_EQ(nearTheEnd.Add(MakeConsoleAsyncRequest()), 0xFFFFFFFFu);
    EXPECT_EQ(nearTheEnd.Add(survivor), 1u);
    EXPECT_EQ(nearTheEnd.Take(1), survivor);
}

TEST(AsyncRequestMapTest, TakeRemoves) {
    AsyncRequestMap map;
    const auto request = MakeConsoleAsyncRequest();
    const uint32_t id = map.Add(request);
    EXPECT_EQ(map.Take(id), request);
    EXPECT_EQ(map.Take(id), nullptr);
    EXPECT_EQ(map.Take(12345), nullptr);
    EXPECT_EQ(map.Size(), 0u);
}

// One console request filed in a map, as after a start half.
class AsyncResponseCallbackTest : public ::testing::Test {
protected:
    const std::shared_ptr<AsyncRequestMap> map = std::make_shared<AsyncRequestMap>();
    const std::shared_ptr<AsyncRequest> request = MakeConsoleAsyncRequest();
    const uint32_t id = map->Add(request);
};

TEST_F(AsyncResponseCallbackTest, RepliesCompleteFiledRequestsAndLateOnesAreDropped) {
    GenericAsyncResponseCallback callback(map);
    callback.OnResponse(Reply("GenericResponse"), id);
    EXPECT_NE(request->Response(), nullptr);
    EXPECT_EQ(map->Size(), 1u);  // stays for the finish
    EXPECT_EQ(map->Take(id), request);

    // After the finish the reply has nowhere to go.
    callback.OnResponse(Reply("GenericResponse"), id);
    EXPECT_EQ(map->Size(), 0u);
}

TEST_F(AsyncResponseCallbackTest, AReplyForAnAbandonedHostSignalDropsTheEntry) {
    uint32_t signal = 0;
    const uint32_t hostId = map->Add(MakeWBAsyncRequest(signal));
    ASSERT_EQ(WBFreeSignal(signal), 0);
    GenericAsyncResponseCallback(map).OnResponse(Reply("GenericResponse"), hostId);
    EXPECT_EQ(map->Take(hostId), nullptr);
    EXPECT_EQ(map->Take(id), request);  // other entries are not touched
}

TEST_F(AsyncResponseCallbackTest, TheIgnoringCallbackPassesOnlyFailures) {
    IgnoringAsyncResponseCallback callback(map);
    callback.OnResponse(Reply("GenericResponse"), id);
    EXPECT_EQ(request->Response(), nullptr);
    callback.OnResponse(ErrorReply("Tag.InvalidState"), id);
    EXPECT_NE(request->Response(), nullptr);
}

TEST(AsyncRequestMapTest, CallersAndTheBusThreadInterleave) {
    const auto map = std::make_shared<AsyncRequestMap>();
    GenericAsyncResponseCallback callback(map);
    constexpr int kCallers = 4;
    constexpr uint32_t kPerCaller = 300;
    std::atomic<bool> done{false};
    std::thread bus([&] {
        // Replies for ids in any order, some after their finish.
        uint32_t id = 1;
        while (!done.load()) {
            callback.OnResponse(Reply("GenericResponse"), id);
            id = id % (kCallers * kPerCaller) + 1;
        }
    });
    std::atomic<int> unknown{0};
    std::vector<std::thread> callers;
    for (int c = 0; c < kCallers; ++c) {
        callers.emplace_back([&] {
            for (uint32_t i = 0; i < kPerCaller; ++i) {
                const auto request = MakeConsoleAsyncRequest();
                const uint32_t id = map->Add(request);
                if (map->Take(id) != request) ++unknown;
            }
        });
    }
    for (auto& caller : callers) caller.join();
    done = true;
    bus.join();
    EXPECT_EQ(unknown.load(), 0);
    EXPECT_EQ(map->Size(), 0u);
}

}  // namespace
}  // namespace Korvane::Veldra::TagLibrary::Testing
