// The host family while the node under it is killed and started again: no
// call blocks the host's thread, and every request ends with a status within
// its time-out.
#include <gtest/gtest.h>

#include <algorithm>
#include <cstdio>
#include <future>
#include <optional>

#include "outage/OutageSupport.h"
#include "support/BrokerEnvironment.h"
#include "support/NodeFaults.h"
#include "wb/WBTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr milliseconds kLongestCall{50};
constexpr milliseconds kFinishMargin{500};
constexpr milliseconds kRequestPace{50};   // a diagram's pace, not a wait for anything
constexpr milliseconds kOutage{3000};

struct Outcome {
    int32_t status = 0;       // of the request call, else of the finish
    milliseconds longestCall{0};
    milliseconds took{0};     // from the request call to its status
    uint32_t timeoutMs = 0;
};

milliseconds Since(OutageClock::time_point start) {
    return std::chrono::duration_cast<milliseconds>(OutageClock::now() - start);
}

// One write as a host diagram makes it: the request call, the wait on its
// signal for at most its time-out, the finish.
Outcome WriteOnce(uint32_t reference, int value) {
    HostArray<WBStrArray> values(NewHostStrings({std::to_string(value)}));
    HostArray<WBTimestampArray> timestamps({WBTimestamp{}});
    HostString error;
    Pending write;
    Outcome outcome;
    const auto start = OutageClock::now();
    outcome.status = TagWBWrite2(reference, kDouble, values.Get(), timestamps.Get(), &write.id,
                                 &write.timeoutMs, &write.signal, &error.handle);
    outcome.longestCall = Since(start);
    outcome.timeoutMs = write.timeoutMs;
    if (outcome.status == 0) {
        WBWaitSignal(write.signal, write.timeoutMs);
        const auto finishing = OutageClock::now();
        outcome.status = TagWBFinishRequestSession(reference, write.id, &error.handle);
        outcome.longestCall = std::max(outcome.longestCall, Since(finishing));
    }
    outcome.took = Since(start);
    if (outcome.status != 0) {
        EXPECT_FALSE(error.Text().empty()) << "status " << outcome.status << " without a text";
    }
    return outcome;
}

TEST_F(WBBrokerTest, AKilledNodeNeverBlocksTheHostAndEveryRequestEndsWithAStatus) {
    const uint32_t reference = Open(UniquePath("outage"), kDouble);
    Write(reference, kDouble, "0.5", 0);

    milliseconds longestCall{0};
    int requests = 0, failed = 0;
    OutageClock::time_point killed;
    const auto run = [&](int value) {
        const auto started = Since(killed);
        const Outcome outcome = WriteOnce(reference, value);
        ++requests;
        longestCall = std::max(longestCall, outcome.longestCall);
        EXPECT_LE(outcome.longestCall, kLongestCall)
            << "a host call blocked; status " << outcome.status << ", started "
            << started.count() << " ms after the kill";
        EXPECT_LE(outcome.took, milliseconds(10000) + kFinishMargin)
            << "a request ended after its time-out; status " << outcome.status;
        if (outcome.status != 0) ++failed;
        return outcome.status;
    };

    ASSERT_TRUE(KillNode());
    killed = OutageClock::now();
    int value = 1;
    while (Since(killed) < kOutage) {
        EXPECT_NE(run(value++), 0) << "a write succeeded with the node down";
        std::this_thread::sleep_for(kRequestPace);
    }
    PortWatch watch(Broker().AmqpPort);
    auto restarted = std::async(std::launch::async, [] { return RestartNode(); });
    std::optional<OutageClock::time_point> firstSuccess;
    while (!firstSuccess && Since(killed) < std::chrono::minutes(2)) {
        if (run(value++) == 0) {
            firstSuccess = OutageClock::now();
        } else {
            std::this_thread::sleep_for(kRequestPace);
        }
    }
    ASSERT_TRUE(restarted.get());
    ASSERT_TRUE(firstSuccess) << "no write succeeded within two minutes of the kill";
    const auto accepted = watch.AwaitAccepted(milliseconds(0));
    ASSERT_TRUE(accepted);
    for (int i = 0; i < 20; ++i) EXPECT_EQ(run(value++), 0) << "write " << i << " after the recovery";
    std::printf("outage wb: %d requests, %d ended in an error, longest host call %lld ms, first success %lld ms "
                "after the node accepted connections\n",
                requests, failed, static_cast<long long>(longestCall.count()),
                MillisBetween(*accepted, *firstSuccess));
    std::fflush(stdout);
    Close(reference);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
