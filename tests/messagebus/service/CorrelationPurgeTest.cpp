#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "messagebus/service/CorrelationPurge.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr int64_t kMs = 1000000;

TEST(CorrelationPurge, ErasesEntriesAtLeastTheMaximumAgeInWholeMilliseconds) {
    const int64_t now = 10000 * kMs;
    CorrIdCallbackMap callbacks;
    const std::vector<std::pair<std::string, int64_t>> agesNs = {
        {"fresh", 0},
        {"almost", 1000 * kMs - 1},  // 999.999 ms counts as 999
        {"exactly", 1000 * kMs},
        {"old", 5000 * kMs},
        {"future", -kMs},  // registered after the clock was read
    };
    for (const auto& [key, age] : agesNs) {
        callbacks.Insert(key, CorrIdCallbackInfo{nullptr, 0, now - age});
    }

    EXPECT_THAT(PurgeCorrelationCallbacks(callbacks, now, 1000),
                ::testing::ElementsAre("exactly", "old"));
    EXPECT_THAT(callbacks.Keys(), ::testing::ElementsAre("almost", "fresh", "future"));
}

TEST(CorrelationPurge, ExpiryErasesTimedOutRequestsAndLeavesTheRest) {
    const int64_t now = 10000 * kMs;
    CorrIdCallbackMap callbacks;
    callbacks.Insert("no time-out", CorrIdCallbackInfo{nullptr, 0, 0, 0});
    callbacks.Insert("timed out", CorrIdCallbackInfo{nullptr, 0, 0, now - 1});
    callbacks.Insert("times out now", CorrIdCallbackInfo{nullptr, 0, 0, now});
    callbacks.Insert("waiting", CorrIdCallbackInfo{nullptr, 0, 0, now + 1});

    EXPECT_THAT(ExpireCorrelationCallbacks(callbacks, now),
                ::testing::ElementsAre("timed out", "times out now"));
    EXPECT_THAT(callbacks.Keys(), ::testing::ElementsAre("no time-out", "waiting"));
}

TEST(CorrelationPurge, ScheduleIsDueOncePerPeriod) {
    PurgeSchedule schedule(0, 1000);
    const std::vector<std::pair<int64_t, bool>> steps = {{999 * kMs, false},
                                                         {1000 * kMs, true},
                                                         {1999 * kMs, false},
                                                         {2000 * kMs, true},
                                                         {2000 * kMs, false}};
    for (const auto& [now, due] : steps) EXPECT_EQ(schedule.Due(now), due) << now / kMs;
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
