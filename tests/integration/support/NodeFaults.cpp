#include "support/NodeFaults.h"

#include <string>
#include <vector>

#include "support/BrokerEnvironment.h"
#include "support/CommandRunner.h"

namespace Korvane::Veldra::Testing {
namespace {

::testing::AssertionResult Succeeds(const std::vector<std::string>& argv, const CommandResult& result) {
    if (result.Ok()) return ::testing::AssertionSuccess();
    std::string command;
    for (const auto& word : argv) command += word + " ";
    return ::testing::AssertionFailure() << command << "exited with " << result.ExitCode << ":\n"
                                         << result.Output;
}

::testing::AssertionResult BrokerScript(const std::string& command, int timeoutSeconds) {
    const std::vector<std::string> argv{"bash", KVVELDRA_BROKER_SCRIPT, command,
                                        BrokerEnvironment::EnvFilePath()};
    return Succeeds(argv, RunCommand(argv, timeoutSeconds));
}

}  // namespace

::testing::AssertionResult KillNode() {
    return BrokerScript("kill", 30);
}

::testing::AssertionResult RestartNode() {
    return BrokerScript("restart", 180);
}

::testing::AssertionResult SetMemoryAlarm(bool raised) {
    // The alarm the node's memory monitor raises, without filling memory; the
    // monitor leaves an alarm alone that it did not raise itself.
    const std::string expression =
        raised ? "rabbit_alarm:set_alarm({{resource_limit, memory, node()}, []})."
               : "rabbit_alarm:clear_alarm({resource_limit, memory, node()}).";
    const std::vector<std::string> args{"eval", expression};
    return Succeeds(args, RunCtl(args));
}

}  // namespace Korvane::Veldra::Testing
