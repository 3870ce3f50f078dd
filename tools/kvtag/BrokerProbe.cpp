#include "BrokerProbe.h"

#include <fcntl.h>
#include <netdb.h>
#include <poll.h>
#include <sys/socket.h>
#include <unistd.h>

#include <cerrno>
#include <memory>

namespace kvtag {
namespace {

constexpr unsigned char kProtocolHeader[] = {'A', 'M', 'Q', 'P', 0, 0, 9, 1};
constexpr unsigned char kMethodFrame = 0x01;

// A socket, closed when it goes.
class Socket {
public:
    explicit Socket(int fd) : fd_(fd) {}
    ~Socket() {
        if (fd_ >= 0) close(fd_);
    }
    Socket(const Socket&) = delete;
    Socket& operator=(const Socket&) = delete;
    int Fd() const { return fd_; }

private:
    int fd_;
};

struct AddressListDeleter {
    void operator()(addrinfo* list) const { freeaddrinfo(list); }
};

// Waits for the events on the socket; false on a time-out or failure.
bool Await(int fd, short events, std::chrono::milliseconds timeout) {
    pollfd entry{fd, events, 0};
    int ready = 0;
    do {
        ready = poll(&entry, 1, static_cast<int>(timeout.count()));
    } while (ready < 0 && errno == EINTR);
    return ready > 0;
}

// Connects within the time-out: 0, or the errno of the failure.
int Connect(int fd, const addrinfo& address, std::chrono::milliseconds timeout) {
    if (connect(fd, address.ai_addr, address.ai_addrlen) == 0) return 0;
    if (errno != EINPROGRESS) return errno;
    if (!Await(fd, POLLOUT, timeout)) return ETIMEDOUT;
    int error = 0;
    socklen_t length = sizeof error;
    if (getsockopt(fd, SOL_SOCKET, SO_ERROR, &error, &length) != 0) return errno;
    return error;
}

ProbeOutcome Knock(int fd, std::chrono::milliseconds timeout) {
    if (send(fd, kProtocolHeader, sizeof kProtocolHeader, MSG_NOSIGNAL) !=
        static_cast<ssize_t>(sizeof kProtocolHeader)) {
        return ProbeOutcome::NotPlainAmqp;
    }
    if (!Await(fd, POLLIN, timeout)) return ProbeOutcome::NotPlainAmqp;
    unsigned char first = 0;
    const ssize_t count = recv(fd, &first, 1, 0);
    // A listener of another AMQP version answers with its own header.
    return count == 1 && (first == kMethodFrame || first == 'A') ? ProbeOutcome::PlainAmqp
                                                                 : ProbeOutcome::NotPlainAmqp;
}

}  // namespace

ProbeOutcome ProbeBroker(const std::string& host, int port, std::chrono::milliseconds timeout) {
    addrinfo hints{};
    hints.ai_family = AF_UNSPEC;
    hints.ai_socktype = SOCK_STREAM;
    addrinfo* found = nullptr;
    if (getaddrinfo(host.c_str(), std::to_string(port).c_str(), &hints, &found) != 0) {
        return ProbeOutcome::Unresolved;
    }
    const std::unique_ptr<addrinfo, AddressListDeleter> addresses(found);
    ProbeOutcome outcome = ProbeOutcome::Refused;
    for (const addrinfo* address = found; address != nullptr; address = address->ai_next) {
        const Socket socket(::socket(address->ai_family,
                                     address->ai_socktype | SOCK_NONBLOCK | SOCK_CLOEXEC,
                                     address->ai_protocol));
        if (socket.Fd() < 0) continue;
        const int error = Connect(socket.Fd(), *address, timeout);
        if (error == 0) return Knock(socket.Fd(), timeout);
        // One address that does not answer outweighs others that refuse.
        if (error != ECONNREFUSED) outcome = ProbeOutcome::Silent;
    }
    return outcome;
}

}  // namespace kvtag
