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

// Disabled while a failed reconnect is never tried again: once the node was
// away for one attempt, every publish fails with -251032 until the instance
// is closed. Run with --gtest_also_run_disabled_tests.
TEST_F(FaultBrokerTest, AStoppedApplicationFailsCallsUntilItIsBack) {
    const uint32_t reference = Open(UniquePath("stopped"));
    ASSERT_NE(reference, 0u);
    ASSERT_TRUE(StopApp());
    const auto figures = MeasureFault(
        "stop_app/start_app", [&] { return Write(reference, "5.5"); }, kRequestTimeout + kCallMargin,
        [] { ASSERT_TRUE(StartApp()); });
    EXPECT_TRUE(figures.firstError);
}

// Disabled while a failed reconnect is never tried again: once the node was
// away for one attempt, every publish fails with -251032 until the instance
// is closed. Run with --gtest_also_run_disabled_tests.
TEST_F(FaultBrokerTest, AKilledNodeFailsCallsUntilItIsRestarted) {
    const uint32_t reference = Open(UniquePath("killed"));
    ASSERT_NE(reference, 0u);
    ASSERT_TRUE(KillNode());
    const auto figures = MeasureFault(
        "kill/restart", [&] { return Write(reference, "6.5"); }, kRequestTimeout + kCallMargin,
        [] { ASSERT_TRUE(RestartNode()); });
    EXPECT_TRUE(figures.firstError);
}

TEST_F(FaultBrokerTest, AMemoryAlarmTimesCallsOutUntilItClears) {
    const uint32_t reference = Open(UniquePath("alarm"));
    ASSERT_NE(reference, 0u);
    ASSERT_TRUE(SetMemoryAlarm(true));
    const auto figures = MeasureFault(
        "memory alarm", [&] { return Write(reference, "7.5"); }, kRequestTimeout + kCallMargin,
        [] { ASSERT_TRUE(SetMemoryAlarm(false)); });
    EXPECT_EQ(figures.errorStatus, kRequestTimedOut);
}

}  // namespace
}  // namespace Korvane::Veldra::Testing
