#include "cluster/ClusterTestSupport.h"

#include <unistd.h>

#include <chrono>
#include <condition_variable>
#include <cstdio>
#include <mutex>
#include <optional>
#include <thread>

#include "cluster/ClusterNodes.h"
#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Testing {
namespace {

using Clock = std::chrono::steady_clock;

constexpr int kSteerRounds = 40;
constexpr Millis kRecoveryTarget{10000};
constexpr Millis kRecoveryLimit{30000};
constexpr Millis kProbePace{250};

Millis Since(Clock::time_point start) {
    return std::chrono::duration_cast<Millis>(Clock::now() - start);
}

bool OnOneOf(const std::vector<ClusterConnection>& connections, const std::set<int>& nodes) {
    for (const auto& connection : connections) {
        if (nodes.count(connection.node) == 0) return false;
    }
    return true;
}

}  // namespace

void ClusterTest::SetUp() {
    static bool attempted = false;
    static bool ready = false;
    if (!attempted) {
        attempted = true;
        UseBrokerDataRoot();
        bool reserved = false;
        ASSERT_EQ(TagConsoleReserve(&reserved), 0);
        std::string error;
        ASSERT_EQ(TagConsoleInitialize(0, nullptr, nullptr, nullptr, &error), 0) << error;
        ready = true;
    }
    ASSERT_TRUE(ready) << "the instance did not start (see above)";
}

std::unique_ptr<TagServiceProcess> ClusterTest::StartService(std::vector<std::string> args) {
    TagServiceOptions options;
    options.dataRoot = UseBrokerDataRoot();
    options.extraArgs = std::move(args);
    return std::make_unique<TagServiceProcess>(options);
}

::testing::AssertionResult ClusterTest::Steer(pid_t pid, const std::set<int>& nodes,
                                              uint32_t reference) {
    const int port = Broker().AmqpPort;
    Write(reference, "0.5");
    const size_t expected = LocalPortsTo(pid, port).size();
    if (expected == 0) return ::testing::AssertionFailure() << "process " << pid << " has no connection";
    std::vector<ClusterConnection> mine;
    for (int round = 0; round < kSteerRounds; ++round) {
        std::vector<ClusterConnection> all;
        auto listed = ListClusterConnections(*nodes.begin(), all);
        if (!listed) return listed;
        const std::set<int> ports = LocalPortsTo(pid, port);
        mine.clear();
        for (const auto& connection : all) {
            if (ports.count(connection.clientPort) != 0) mine.push_back(connection);
        }
        if (mine.size() == expected) {
            if (OnOneOf(mine, nodes)) return ::testing::AssertionSuccess();
            for (const auto& connection : mine) {
                if (nodes.count(connection.node) != 0) continue;
                auto closed = CloseClusterConnection(*nodes.begin(), connection.pid);
                if (!closed) return closed;
                break;
            }
        }
        // Reconnects the publisher; the consumer comes back by itself.
        Write(reference, "0.5");
    }
    return ::testing::AssertionFailure() << "process " << pid << " kept " << mine.size() << " of "
                                         << expected << " connections off the chosen nodes";
}

void ClusterTest::MeasureLoss(const std::string& name, int node, uint32_t reference) {
    ASSERT_TRUE(KillClusterNode(node));
    const auto killed = Clock::now();
    // A write starts every kProbePace on a thread of its own, so that a
    // request lost with the node, whose caller waits out its time-out, does
    // not hide the writes that succeed after it.
    std::mutex mutex;
    std::condition_variable succeeded;
    std::optional<Millis> first;
    std::string failures;
    std::vector<std::thread> probes;
    std::unique_lock<std::mutex> lock(mutex);
    while (!first && Since(killed) < kRecoveryLimit) {
        probes.emplace_back([&, started = Since(killed)] {
            const CallResult result = Write(reference, "8.5");
            EXPECT_LE(result.took, kRequestTimeout + kCallMargin) << name << ": a write overran";
            const std::lock_guard<std::mutex> guard(mutex);
            if (result.status == 0) {
                if (!first || Since(killed) < *first) first = Since(killed);
                succeeded.notify_all();
            } else {
                EXPECT_TRUE(IsBusFailure(result.status)) << name << ": " << result.error;
                failures += " " + std::to_string(result.status) + " after " +
                            std::to_string(result.took.count()) + " ms, sent at " +
                            std::to_string(started.count()) + " ms;";
            }
        });
        succeeded.wait_for(lock, kProbePace, [&] { return first.has_value(); });
    }
    lock.unlock();
    for (auto& probe : probes) probe.join();
    ASSERT_TRUE(first) << name << ": no write succeeded within " << kRecoveryLimit.count() << " ms";
    EXPECT_LE(*first, kRecoveryTarget) << name;
    std::printf("cluster recovery (%s): %lld ms from the kill to the first successful write "
                "(%zu writes started; failed:%s)\n",
                name.c_str(), static_cast<long long>(first->count()), probes.size(),
                failures.empty() ? " none" : failures.c_str());
    std::fflush(stdout);
    RecordProperty("recovery_ms", std::to_string(first->count()));
}

void ClusterTest::ExpectNoReplyLost(uint32_t reference) {
    int failed = 0;
    std::string first;
    int i = 0;
    // Three failures tell enough; a hundred time-outs would outlast the test.
    for (; i < 100 && failed < 3; ++i) {
        const CallResult result = Write(reference, std::to_string(i) + ".25");
        if (result.status != 0 && ++failed == 1) first = std::to_string(result.status) + " " + result.error;
    }
    EXPECT_EQ(failed, 0) << "of " << i << " writes after the loss; the first: " << first;
}

std::map<uint32_t, std::string> ClusterTest::WriteTags(const std::string& stem) {
    std::map<uint32_t, std::string> written;
    for (int i = 0; i < 3; ++i) {
        const uint32_t reference = Open(UniquePath(stem));
        const std::string value = std::to_string(i) + ".75";
        EXPECT_EQ(Write(reference, value).status, 0);
        written[reference] = value;
    }
    return written;
}

void ClusterTest::ExpectReadBack(const std::map<uint32_t, std::string>& written) {
    for (const auto& [reference, value] : written) {
        TagConsoleValue read;
        EXPECT_EQ(Read(reference, read).status, 0);
        EXPECT_EQ(read.value, value);
    }
}

void ClusterTest::RestartAndExpectAllRunning(int node) {
    ASSERT_TRUE(RestartClusterNode(node));
    std::set<int> running;
    ASSERT_TRUE(RunningNodes(node, running));
    EXPECT_EQ(running, (std::set<int>{1, 2, 3}));
    EXPECT_EQ(NodeRuntimeCount(), kClusterNodes);
}

}  // namespace Korvane::Veldra::Testing
