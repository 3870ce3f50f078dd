// The console family while the node under it is killed and started again:
// no call outlives its time-out, writes succeed again soon after the node
// serves, and no reply is lost after that.
#include <gtest/gtest.h>
#include <kvveldra/TagConsole.h>
#include <unistd.h>

#include <algorithm>
#include <cstdio>
#include <future>
#include <optional>
#include <string>

#include "outage/OutageSupport.h"
#include "support/BrokerEnvironment.h"
#include "support/ExportedNumbers.h"
#include "support/NodeFaults.h"
#include "support/SuiteTagService.h"
#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr milliseconds kRequestTimeout{10000};
constexpr milliseconds kCallMargin{1000};
constexpr milliseconds kWritePace{100};   // a writer's pace, not a wait for anything
constexpr milliseconds kOutage{3000};      // how long the node stays down
constexpr milliseconds kRecoveryLimit{5000};

struct Call {
    int32_t status = 0;
    std::string error;
    milliseconds took{0};
};

// Instance 0, whose connect time-out is 180 s, against a tag service on a
// durable queue.
class ConsoleOutageTest : public ::testing::Test {
protected:
    void SetUp() override {
        ASSERT_TRUE(Suite().EnsureSuite(StartSuite)) << "the tag service or the instance did not start";
    }
    static void TearDownTestSuite() {
        bool reserved = true;
        TagConsoleUnreserve(&reserved);
        Suite().Stop();
    }

    static SuiteTagService& Suite() {
        static SuiteTagService suite("kvveldra-outage-console", DurableQueueArgs("console"));
        return suite;
    }
    static void StartSuite() {
        UseBrokerDataRoot();
        Suite().Start();
        bool reserved = false;
        ASSERT_EQ(TagConsoleReserve(&reserved), 0);
        std::string error;
        ASSERT_EQ(TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error), 0) << error;
    }

    static uint32_t Open(const std::string& path) {
        uint32_t reference = 0;
        std::string error;
        EXPECT_EQ(TagConsoleOpen(0, &path, kDouble, false, &reference, &error), 0) << error;
        return reference;
    }
    static Call Write(uint32_t reference, int value) {
        const TagConsoleSamples samples{{std::to_string(value), TagConsoleTime(std::chrono::seconds(value))}};
        Call call;
        const auto start = OutageClock::now();
        call.status = TagConsoleWriteTag(reference, kDouble, &samples, false, &call.error);
        call.took = std::chrono::duration_cast<milliseconds>(OutageClock::now() - start);
        return call;
    }
};

TEST_F(ConsoleOutageTest, AKilledNodeHoldsNoCallPastItsTimeOutAndLosesNoReplyOnceItIsBack) {
    const uint32_t reference = Open("outage." + std::to_string(getpid()) + ".console");
    ASSERT_NE(reference, 0u);
    int value = 1;
    ASSERT_EQ(Write(reference, value++).status, 0);

    ASSERT_TRUE(KillNode());
    const auto killed = OutageClock::now();
    const double cpuAtKill = ProcessCpuSeconds();
    milliseconds longest{0};
    int failed = 0;
    const auto check = [&](const Call& call) {
        longest = std::max(longest, call.took);
        EXPECT_LE(call.took, kRequestTimeout + kCallMargin) << "status " << call.status << " " << call.error;
        if (call.status != 0) {
            ++failed;
            EXPECT_FALSE(call.error.empty()) << "status " << call.status;
        }
    };
    while (OutageClock::now() - killed < kOutage) {
        const Call call = Write(reference, value++);
        check(call);
        EXPECT_NE(call.status, 0) << "a write succeeded with the node down";
        std::this_thread::sleep_for(kWritePace);
    }
    const double downSeconds = std::chrono::duration<double>(OutageClock::now() - killed).count();
    const double cpuShare = (ProcessCpuSeconds() - cpuAtKill) / downSeconds;

    PortWatch watch(Broker().AmqpPort);
    auto restarted = std::async(std::launch::async, [] { return RestartNode(); });
    std::optional<OutageClock::time_point> firstSuccess;
    while (!firstSuccess && OutageClock::now() - killed < std::chrono::minutes(2)) {
        const Call call = Write(reference, value++);
        check(call);
        if (call.status == 0) {
            firstSuccess = OutageClock::now();
        } else {
            std::this_thread::sleep_for(kWritePace);
        }
    }
    ASSERT_TRUE(restarted.get());
    const auto accepted = watch.AwaitAccepted(milliseconds(0));
    ASSERT_TRUE(accepted) << "the node never accepted a connection";
    ASSERT_TRUE(firstSuccess) << "no write succeeded within two minutes of the kill";
    const long long recoveryMs = MillisBetween(*accepted, *firstSuccess);
    EXPECT_LE(recoveryMs, kRecoveryLimit.count()) << "writes came back too late";

    int answered = 0;
    for (int i = 0; i < 50; ++i) {
        const Call call = Write(reference, value++);
        EXPECT_EQ(call.status, 0) << "write " << i << " after the recovery: " << call.error;
        if (call.status == 0) ++answered;
    }
    EXPECT_LT(cpuShare, 0.05) << "the process used " << cpuShare * 100 << " % of a core while the node was down";
    std::printf("outage console: longest call %lld ms, %d calls failed, first success %lld ms after the node "
                "accepted connections, %d of 50 writes answered after it, %.2f %% of a core while down\n",
                static_cast<long long>(longest.count()), failed, recoveryMs, answered, cpuShare * 100);
    std::fflush(stdout);
    std::string error;
    EXPECT_EQ(TagConsoleClose(reference, false, &error), 0) << error;
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
