// A writer of the console family and the reference tag service, both through
// the balancer in front of three nodes, while the node under them is killed.
#include <unistd.h>

#include <chrono>
#include <cstdio>
#include <functional>
#include <future>
#include <vector>

#include "cluster/ClusterNodes.h"
#include "cluster/ClusterTestSupport.h"

namespace Korvane::Veldra::Testing {
namespace {

using Clock = std::chrono::steady_clock;

TEST_F(ClusterTest, AWriterAndItsServiceOnOneNodeGoOnWhenItDies) {
    const auto service = StartService();
    const uint32_t reference = Open(UniquePath("one-node"));
    ASSERT_TRUE(Steer(service->Pid(), {1}, reference));
    ASSERT_TRUE(Steer(getpid(), {1}, reference));
    const auto written = WriteTags("one-node-kept");

    MeasureLoss("writer and service on the killed node", 1, reference);
    ExpectNoReplyLost(reference);
    ExpectReadBack(written);
    RestartAndExpectAllRunning(1);
}

TEST_F(ClusterTest, AWriterAndItsServiceOnDifferentNodesGoOnWhenEitherDies) {
    const auto service = StartService();
    const uint32_t reference = Open(UniquePath("two-nodes"));
    const auto written = WriteTags("two-nodes-kept");

    ASSERT_TRUE(Steer(service->Pid(), {2}, reference));
    ASSERT_TRUE(Steer(getpid(), {3}, reference));
    MeasureLoss("the service's node killed", 2, reference);
    ExpectNoReplyLost(reference);
    RestartAndExpectAllRunning(2);

    ASSERT_TRUE(Steer(service->Pid(), {1, 2}, reference));
    ASSERT_TRUE(Steer(getpid(), {3}, reference));
    MeasureLoss("the writer's node killed", 3, reference);
    ExpectNoReplyLost(reference);
    ExpectReadBack(written);
    RestartAndExpectAllRunning(3);
}

// A durable classic queue lives on the node that declared it and is refused
// while that node is down.
TEST_F(ClusterTest, AClassicDurableServiceQueueWaitsForItsHomeNode) {
    const std::string suffix = std::to_string(getpid());
    const std::string queue = "TagService_classic" + suffix;
    const auto service = StartService({"--durable-queue", "classic" + suffix});
    const uint32_t reference = Open(UniquePath("classic"));
    int home = 0;
    ASSERT_TRUE(QueueNode(1, queue, home));
    std::set<int> others{1, 2, 3};
    others.erase(home);
    ASSERT_TRUE(Steer(getpid(), others, reference));
    ASSERT_TRUE(KillClusterNode(home));
    const auto killed = Clock::now();
    while (Clock::now() - killed < Millis(5000)) {
        const CallResult result = Write(reference, "3.5");
        EXPECT_TRUE(IsBusFailure(result.status)) << "status " << result.status;
    }
    const FaultFigures figures = MeasureFault(
        "classic queue's home node back", [&] { return Write(reference, "3.5"); }, Millis(0),
        [&] { RestartAndExpectAllRunning(home); });
    EXPECT_TRUE(figures.firstSuccess);
    service->Stop();
    EXPECT_TRUE(ClusterScript("ctl", {"1", "-q", "delete_queue", queue}, 60).Ok());
}

// Waits, bounded, until quorum queue `queue` has its leader on a node other
// than `lost`, asking node `via`, and prints the time from `since`. Before
// each look (a rabbitmqctl call of some 300 ms) `beforeEachLook` runs.
::testing::AssertionResult AwaitNewLeader(int via, const std::string& queue, int lost,
                                          Clock::time_point since,
                                          const std::function<void()>& beforeEachLook) {
    int leader = lost;
    while (leader == lost && Clock::now() - since < std::chrono::seconds(30)) {
        beforeEachLook();
        if (!QueueNode(via, queue, leader)) leader = lost;
    }
    if (leader == lost) return ::testing::AssertionFailure() << queue << " kept no leader";
    std::printf("cluster recovery (quorum queue's new leader): %lld ms from the kill\n",
                static_cast<long long>(
                    std::chrono::duration_cast<Millis>(Clock::now() - since).count()));
    return ::testing::AssertionSuccess();
}

// A quorum queue goes on with a new leader: the service's consumers come back
// on it, and a client that connects once the leader is elected is answered. A
// writer that was busy across the kill may get no answer until the old
// leader's node is back (the library never asks for publisher confirms, so a
// publish lost in the leader change goes unnoticed): what must hold for it is
// that it is answered again once the node is back.
TEST_F(ClusterTest, AQuorumServiceQueueOutlivesItsLeader) {
    const std::string suffix = std::to_string(getpid());
    const std::string queue = "TagService_quorum" + suffix;
    const auto service =
        StartService({"--durable-queue", "quorum" + suffix, "--queue-type", "quorum"});
    const std::string path = UniquePath("quorum");
    const uint32_t reference = Open(path);
    ASSERT_TRUE(AwaitAllMembersOnline(1, queue));
    int leader = 0;
    ASSERT_TRUE(QueueNode(1, queue, leader));
    ASSERT_TRUE(Steer(service->Pid(), {leader}, reference));
    std::set<int> others{1, 2, 3};
    others.erase(leader);
    ASSERT_TRUE(Steer(getpid(), others, reference));
    ASSERT_EQ(Write(reference, "1.5").status, 0);

    ASSERT_TRUE(KillClusterNode(leader));
    const auto killed = Clock::now();
    // A busy writer across the kill: a write on a thread of its own before
    // each look for the new leader.
    std::vector<std::future<CallResult>> across;
    const auto writeAcross = [&] {
        across.push_back(std::async(std::launch::async, [&] { return Write(reference, "2.5"); }));
    };
    ASSERT_TRUE(AwaitNewLeader(*others.begin(), queue, leader, killed, writeAcross));
    std::string error;
    ASSERT_EQ(TagConsoleInitialize(1, nullptr, nullptr, nullptr, &error), 0) << error;
    const FaultFigures answered = MeasureFault(
        "quorum queue's leader killed, a client connecting after the election",
        [&] {
            CallResult result;
            uint32_t opened = 0;
            result.status = TagConsoleOpen(1, &path, kDouble, false, &opened, &result.error);
            return result;
        },
        Millis(0), [] {});
    EXPECT_TRUE(answered.firstSuccess);
    uint32_t later = 0;
    ASSERT_EQ(TagConsoleOpen(1, &path, kDouble, false, &later, &error), 0) << error;
    TagConsoleValue before;
    ASSERT_EQ(Read(later, before).status, 0);
    EXPECT_TRUE(before.value == "1.5" || before.value == "2.5") << before.value;
    std::string statuses;
    for (auto& write : across) statuses += " " + std::to_string(write.get().status);
    std::printf("the default instance's writes across the kill:%s\n", statuses.c_str());
    ExpectNoReplyLost(later);
    ExpectReadBack({{later, "99.25"}});

    const FaultFigures figures = MeasureFault(
        "quorum queue's old leader back, the writer that was publishing",
        [&] { return Write(reference, "3.5"); }, Millis(0),
        [&] { RestartAndExpectAllRunning(leader); });
    EXPECT_TRUE(figures.firstSuccess);
    if (HasFailure()) std::printf("the service's output:\n%s\n", service->Output().c_str());
    EXPECT_EQ(TagConsoleCloseInstance(1, &error), 0) << error;
    service->Stop();
    EXPECT_TRUE(ClusterScript("ctl", {"1", "-q", "delete_queue", queue}, 60).Ok());
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
