#pragma once

#include <gtest/gtest.h>

namespace Korvane::Veldra::Testing {

// Faults of the whole private node, beside BrokerEnvironment.h's
// CloseAllConnections, StopApp and StartApp; each fails with the tool's output.

// SIGKILL to every process of the node, as a crash; RestartNode starts it
// again on the same ports and data and returns once it serves.
::testing::AssertionResult KillNode();
::testing::AssertionResult RestartNode();

// Raises the node's memory alarm, which blocks every publishing connection,
// or clears it again.
::testing::AssertionResult SetMemoryAlarm(bool raised);

}  // namespace Korvane::Veldra::Testing
