#include "outage/OutageSupport.h"

#include <arpa/inet.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <time.h>
#include <unistd.h>

namespace Korvane::Veldra::Testing {
namespace {

// How often the port is tried: there is no event to await in another process.
constexpr milliseconds kProbePace{20};

bool Accepts(int port) {
    const int fd = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (fd < 0) return false;
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(static_cast<uint16_t>(port));
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    const bool accepted = connect(fd, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
    close(fd);
    return accepted;
}

}  // namespace

double ProcessCpuSeconds() {
    timespec now{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &now);
    return static_cast<double>(now.tv_sec) + static_cast<double>(now.tv_nsec) / 1e9;
}

long long MillisBetween(OutageClock::time_point from, OutageClock::time_point to) {
    return std::chrono::duration_cast<milliseconds>(to - from).count();
}

PortWatch::PortWatch(int port) : thread_([this, port] { Run(port); }) {}

PortWatch::~PortWatch() {
    {
        std::lock_guard<std::mutex> lock(mutex_);
        stop_ = true;
    }
    changed_.notify_all();
    thread_.join();
}

void PortWatch::Run(int port) {
    std::unique_lock<std::mutex> lock(mutex_);
    while (!stop_) {
        lock.unlock();
        const bool accepted = Accepts(port);
        const auto now = OutageClock::now();
        lock.lock();
        if (accepted) {
            accepted_ = now;
            changed_.notify_all();
            return;
        }
        changed_.wait_for(lock, kProbePace, [this] { return stop_; });
    }
}

std::optional<OutageClock::time_point> PortWatch::AwaitAccepted(milliseconds timeout) {
    std::unique_lock<std::mutex> lock(mutex_);
    changed_.wait_for(lock, timeout, [this] { return accepted_.has_value(); });
    return accepted_;
}

std::vector<std::string> DurableQueueArgs(const std::string& stem) {
    return {"--durable-queue", "outage_" + stem + "_" + std::to_string(getpid())};
}

}  // namespace Korvane::Veldra::Testing
