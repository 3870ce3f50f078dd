// Faults of the node itself: its connections closed, its application stopped,
// the node killed, and a memory alarm that blocks publishers.
#include "faults/FaultTestSupport.h"
#include "support/BrokerEnvironment.h"
#include "support/NodeFaults.h"

namespace Korvane::Veldra::Testing {
namespace {

TEST_F(FaultBrokerTest, ClosedConnectionsAreOvercome) {
    const uint32_t reference = Open(UniquePath("closed"));
    ASSERT_NE(reference, 0u);
    ASSERT_TRUE(CloseAllConnections());
    MeasureFault(
        "close_all_connections", [&] { return Write(reference, "4.5"); }, Millis(3000), [] {});
}

// A stopped application refuses connections: the failed reconnect is tried
// again until the node is back.
TEST_F(FaultBrokerTest, AStoppedApplicationFailsCallsUntilItIsBack) {
    const auto figures = MeasureNodeFault("stop_app/start_app", "5.5", StopApp,
                                          [] { ASSERT_TRUE(StartApp()); });
    EXPECT_TRUE(figures.firstError);
}

TEST_F(FaultBrokerTest, AKilledNodeFailsCallsUntilItIsRestarted) {
    const auto figures = MeasureNodeFault("kill/restart", "6.5", KillNode,
                                          [] { ASSERT_TRUE(RestartNode()); });
    EXPECT_TRUE(figures.firstError);
}

TEST_F(FaultBrokerTest, AMemoryAlarmTimesCallsOutUntilItClears) {
    const auto figures = MeasureNodeFault(
        "memory alarm", "7.5", [] { return SetMemoryAlarm(true); },
        [] { ASSERT_TRUE(SetMemoryAlarm(false)); });
    EXPECT_EQ(figures.errorStatus, kRequestTimedOut);
}

}  // namespace

FaultFigures FaultBrokerTest::MeasureNodeFault(
    const std::string& name, const std::string& value,
    const std::function<::testing::AssertionResult()>& inject, const std::function<void()>& lift) {
    const uint32_t reference = Open(UniquePath("node"));
    EXPECT_NE(reference, 0u);
    EXPECT_TRUE(inject());
    return MeasureFault(
        name, [&] { return Write(reference, value); }, kRequestTimeout + kCallMargin, lift);
}

}  // namespace Korvane::Veldra::Testing
