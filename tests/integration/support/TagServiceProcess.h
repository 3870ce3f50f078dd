#pragma once

#include <sys/types.h>

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>
#include <vector>

#include "support/BrokerSettings.h"

namespace Korvane::Veldra::Testing {

// Writes <directory>/VeldraConfigurations/<id>.json describing the private
// broker (plain AMQP on Host and AmqpPort, its user, the tests' exchange) and
// returns <directory>. The directory is made when missing.
std::string WriteBrokerDataRoot(const BrokerSettings& broker, const std::string& directory,
                                const std::string& id = "veldra_master",
                                const std::string& exchange = "kvveldra.amqpio.test");

// The test process's own data root: made once under $TMPDIR with
// WriteBrokerDataRoot(Broker(), ...), and VELDRA_DATA_DIR set to it before
// returning. Call it before anything in the process reads the data root.
const std::string& UseBrokerDataRoot();

// How to start kvveldra-tagservice: TagServiceProcess::Options. Declared
// outside the class, so that it is complete where it is a default argument.
struct TagServiceOptions {
    std::string store;              // --store FILE; empty: in memory
    bool verbose = false;           // --verbose
    std::string dataRoot;           // VELDRA_DATA_DIR of the child; empty: UseBrokerDataRoot()
    std::vector<std::string> extraArgs;
    std::string readyLine;          // the line to wait for; empty: the ready line
};

// A kvveldra-tagservice child process with its standard output and standard
// error collected.
class TagServiceProcess {
public:
    using Options = TagServiceOptions;

    // Starts kvveldra-tagservice and returns once it serves: it prints its
    // ready line after its consumers are started (or once it printed
    // Options::readyLine, when that is given). Throws std::runtime_error
    // with the child's output when the line does not come within 30 seconds
    // or the child ends first.
    explicit TagServiceProcess(Options options = {});
    ~TagServiceProcess();  // Stop() if still running
    TagServiceProcess(const TagServiceProcess&) = delete;
    TagServiceProcess& operator=(const TagServiceProcess&) = delete;

    // SIGTERM, then a bounded wait (SIGKILL after 30 seconds); the exit
    // status, or 128 + the signal that ended the child. Once stopped, the
    // status of that stop.
    int Stop();
    // SIGKILL and reap.
    void Kill();
    pid_t Pid() const { return pid_; }
    // What the child printed so far, standard output and error interleaved.
    std::string Output() const;

    // True once the output holds text; false when the child ends first or
    // the timeout runs out.
    bool WaitForOutput(const std::string& text, std::chrono::milliseconds timeout) const;

private:
    void ReadOutput(int fd);
    // Waits for the end of the output (the child closed it, normally by
    // ending) within the timeout.
    bool WaitForEnd(std::chrono::milliseconds timeout) const;
    int Reap();

    pid_t pid_ = -1;
    bool reaped_ = false;
    int status_ = -1;
    mutable std::mutex mutex_;
    mutable std::condition_variable changed_;
    std::string output_;
    bool ended_ = false;
    std::thread reader_;
};

}  // namespace Korvane::Veldra::Testing
