#pragma once

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <mutex>
#include <optional>
#include <string>
#include <thread>
#include <vector>

namespace Korvane::Veldra::Testing {

using OutageClock = std::chrono::steady_clock;
using std::chrono::milliseconds;

// The CPU time of this process, all threads, in seconds.
double ProcessCpuSeconds();

// Whole milliseconds from `from` to `to`.
long long MillisBetween(OutageClock::time_point from, OutageClock::time_point to);

// Watches a loopback TCP port from a thread of its own and notes the moment
// it first accepts a connection: when a restarted node serves again.
class PortWatch {
public:
    explicit PortWatch(int port);
    ~PortWatch();
    PortWatch(const PortWatch&) = delete;
    PortWatch& operator=(const PortWatch&) = delete;

    // When the port first accepted, once it has within the timeout.
    std::optional<OutageClock::time_point> AwaitAccepted(milliseconds timeout);

private:
    void Run(int port);

    std::mutex mutex_;
    std::condition_variable changed_;
    std::optional<OutageClock::time_point> accepted_;
    bool stop_ = false;
    std::thread thread_;
};

// The arguments that put the reference tag service on a durable queue of
// this process: the requests sent while it reconnects after a node restart
// wait there for it.
std::vector<std::string> DurableQueueArgs(const std::string& stem);

}  // namespace Korvane::Veldra::Testing
