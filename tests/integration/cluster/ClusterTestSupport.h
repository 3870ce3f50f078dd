#pragma once

#include <sys/types.h>

#include <map>
#include <memory>
#include <set>
#include <string>
#include <vector>

#include "faults/FaultTestSupport.h"
#include "support/TagServiceProcess.h"

namespace Korvane::Veldra::Testing {

// The console family on the default instance and the reference tag service,
// both reaching the cluster through its balancer (Broker()). Reuses the fault
// tests' calls and measurement, without their proxy.
class ClusterTest : public FaultBrokerTest {
protected:
    void SetUp() override;

    // A kvveldra-tagservice on an in-memory store with these arguments.
    static std::unique_ptr<TagServiceProcess> StartService(std::vector<std::string> args = {});

    // Closes connections of process `pid` (this one's or the service's) until
    // each of them sits on one of `nodes`; the balancer sends each reconnect
    // to the next node in turn. `reference` is written to make the
    // connections come back. Bounded.
    static ::testing::AssertionResult Steer(pid_t pid, const std::set<int>& nodes,
                                            uint32_t reference);

    // Kills node `node` and writes until a write succeeds; expects that
    // within 10 s, prints and records the time from the kill as `name`.
    static void MeasureLoss(const std::string& name, int node, uint32_t reference);
    // A hundred writes after the loss, each answered.
    static void ExpectNoReplyLost(uint32_t reference);
    // Opens a tag and writes it once: its reference and value, to read back
    // after a loss with ExpectReadBack.
    static std::map<uint32_t, std::string> WriteTags(const std::string& stem);
    static void ExpectReadBack(const std::map<uint32_t, std::string>& written);
    // Starts node `node` again; expects all nodes running, one runtime each.
    static void RestartAndExpectAllRunning(int node);
};

}  // namespace Korvane::Veldra::Testing
