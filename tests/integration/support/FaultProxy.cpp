#include "support/FaultProxy.h"

#include <arpa/inet.h>
#include <fcntl.h>
#include <netinet/in.h>
#include <poll.h>
#include <sys/eventfd.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>
#include <cstring>
#include <deque>
#include <list>
#include <stdexcept>
#include <string>
#include <vector>

namespace Korvane::Veldra::Testing {
namespace {

using Clock = std::chrono::steady_clock;
constexpr size_t kMaxPending = 1 << 20;  // per direction; reading pauses above it

struct Chunk {
    Clock::time_point due;
    std::string bytes;
};

// One direction of a pair: what came from one side and waits for the other.
struct Flow {
    std::deque<Chunk> chunks;
    size_t pending = 0;
};

void CloseReset(int& fd) {
    if (fd < 0) return;
    const linger hard{1, 0};
    setsockopt(fd, SOL_SOCKET, SO_LINGER, &hard, sizeof hard);
    close(fd);
    fd = -1;
}

int ConnectTo(int port) {
    const int fd = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (fd < 0) return -1;
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(static_cast<uint16_t>(port));
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    // A loopback connect is answered at once, accepted or refused.
    if (connect(fd, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0) {
        close(fd);
        return -1;
    }
    fcntl(fd, F_SETFL, O_NONBLOCK);
    return fd;
}

}  // namespace

struct FaultProxy::Pair {
    int fd[2] = {-1, -1};  // the client's side, the target's side
    Flow flow[2];          // flow[i]: read from fd[i], written to fd[1 - i]
    bool swallowed = false;
    bool closing = false;  // one side ended: flush what it sent, then close both

    ~Pair() {
        for (int& side : fd) {
            if (closing && side >= 0) close(side);
            else CloseReset(side);
        }
    }
};

FaultProxy::FaultProxy(int targetPort) : targetPort_(targetPort) {
    listenFd_ = socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC | SOCK_NONBLOCK, 0);
    wakeFd_ = eventfd(0, EFD_CLOEXEC | EFD_NONBLOCK);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    if (listenFd_ < 0 || wakeFd_ < 0 ||
        bind(listenFd_, reinterpret_cast<sockaddr*>(&address), sizeof address) != 0 ||
        listen(listenFd_, 64) != 0 ||
        getsockname(listenFd_, reinterpret_cast<sockaddr*>(&address), &length) != 0) {
        const std::string reason = std::strerror(errno);
        if (listenFd_ >= 0) close(listenFd_);
        if (wakeFd_ >= 0) close(wakeFd_);
        throw std::runtime_error("FaultProxy: cannot listen: " + reason);
    }
    port_ = ntohs(address.sin_port);
    thread_ = std::thread([this] { Run(); });
}

FaultProxy::~FaultProxy() {
    {
        std::lock_guard<std::mutex> lock(mutex_);
        stop_ = true;
    }
    Wake();
    thread_.join();
    close(listenFd_);
    close(wakeFd_);
}

void FaultProxy::Wake() const {
    const uint64_t one = 1;
    [[maybe_unused]] const ssize_t written = write(wakeFd_, &one, sizeof one);
}

void FaultProxy::SetMode(Mode mode, std::chrono::milliseconds delay) {
    {
        std::lock_guard<std::mutex> lock(mutex_);
        mode_ = mode;
        delay_ = delay;
    }
    Wake();
}

bool FaultProxy::ResetAll() {
    std::unique_lock<std::mutex> lock(mutex_);
    const unsigned ticket = ++resetsAsked_;
    Wake();
    return resetDone_.wait_for(lock, std::chrono::seconds(5), [&] { return resetsDone_ >= ticket; });
}

int FaultProxy::Connections() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return connections_;
}

void FaultProxy::Run() {
    std::list<Pair> pairs;
    Mode mode = Mode::Pass;
    std::chrono::milliseconds delay{0};
    for (;;) {
        {
            std::lock_guard<std::mutex> lock(mutex_);
            if (stop_) break;
            if (resetsDone_ != resetsAsked_) {
                pairs.clear();
                resetsDone_ = resetsAsked_;
                resetDone_.notify_all();
            }
            if (mode_ != Mode::BlackHole && mode == Mode::BlackHole) {
                pairs.remove_if([](const Pair& pair) { return pair.swallowed || pair.fd[1] < 0; });
            }
            mode = mode_;
            delay = delay_;
            connections_ = static_cast<int>(pairs.size());
        }
        const auto now = Clock::now();
        auto wait = std::chrono::milliseconds(100);
        std::vector<pollfd> fds{{wakeFd_, POLLIN, 0}, {listenFd_, POLLIN, 0}};
        for (auto& pair : pairs) {
            for (int side = 0; side < 2; ++side) {
                short events = 0;
                if (pair.fd[side] < 0) continue;
                if (!pair.closing && pair.flow[side].pending < kMaxPending) events |= POLLIN;
                const Flow& out = pair.flow[1 - side];
                if (!out.chunks.empty() && mode != Mode::BlackHole) {
                    const auto left = std::chrono::ceil<std::chrono::milliseconds>(out.chunks.front().due - now);
                    if (left.count() <= 0) events |= POLLOUT;
                    else if (left < wait) wait = left;
                }
                fds.push_back({events != 0 ? pair.fd[side] : -1, events, 0});  // -1: not polled
            }
        }
        if (poll(fds.data(), fds.size(), static_cast<int>(wait.count())) < 0 && errno != EINTR) break;
        if (fds[0].revents & POLLIN) {
            uint64_t drained;
            [[maybe_unused]] const ssize_t got = read(wakeFd_, &drained, sizeof drained);
        }
        size_t index = 2;
        for (auto it = pairs.begin(); it != pairs.end();) {
            Pair& pair = *it;
            bool broken = false;
            for (int side = 0; side < 2; ++side) {
                if (pair.fd[side] < 0) continue;
                const short revents = fds[index++].revents;
                if (!pair.closing && (revents & (POLLIN | POLLHUP | POLLERR))) {
                    char buffer[65536];
                    const ssize_t count = read(pair.fd[side], buffer, sizeof buffer);
                    if (count > 0 && mode == Mode::BlackHole) {
                        pair.swallowed = true;
                    } else if (count > 0) {
                        const auto due = Clock::now() + (mode == Mode::Delay ? delay : std::chrono::milliseconds(0));
                        pair.flow[side].chunks.push_back({due, std::string(buffer, static_cast<size_t>(count))});
                        pair.flow[side].pending += static_cast<size_t>(count);
                    } else if (count == 0 || (errno != EAGAIN && errno != EINTR)) {
                        // The target going away in the black hole is not shown to the client.
                        if (mode == Mode::BlackHole && side == 1) CloseReset(pair.fd[1]);
                        else if (count == 0) pair.closing = true;
                        else broken = true;
                    }
                }
                Flow& out = pair.flow[1 - side];
                while ((revents & POLLOUT) && !out.chunks.empty() && out.chunks.front().due <= Clock::now()) {
                    Chunk& chunk = out.chunks.front();
                    const ssize_t sent = send(pair.fd[side], chunk.bytes.data(), chunk.bytes.size(), MSG_NOSIGNAL);
                    if (sent < 0) {
                        broken = errno != EAGAIN && errno != EINTR;
                        break;
                    }
                    out.pending -= static_cast<size_t>(sent);
                    chunk.bytes.erase(0, static_cast<size_t>(sent));
                    if (!chunk.bytes.empty()) break;
                    out.chunks.pop_front();
                }
            }
            if (broken) pair.closing = false;
            const bool flushed = pair.flow[0].chunks.empty() && pair.flow[1].chunks.empty();
            it = broken || (pair.closing && flushed) ? pairs.erase(it) : std::next(it);
        }
        // After the pairs: a new pair has no entry in this round's fds.
        if (fds[1].revents & POLLIN) {
            const int client = accept4(listenFd_, nullptr, nullptr, SOCK_CLOEXEC | SOCK_NONBLOCK);
            if (client >= 0) {
                // In the black hole the target never hears of the connection.
                const int target = mode == Mode::BlackHole ? -1 : ConnectTo(targetPort_);
                if (target < 0 && mode != Mode::BlackHole) {
                    int fd = client;
                    CloseReset(fd);  // refused, as the target refused us
                } else {
                    pairs.emplace_back();
                    pairs.back().fd[0] = client;
                    pairs.back().fd[1] = target;
                    pairs.back().swallowed = target < 0;
                }
            }
        }
    }
    pairs.clear();
}

}  // namespace Korvane::Veldra::Testing
