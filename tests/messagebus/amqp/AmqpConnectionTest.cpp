#include <gtest/gtest.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

#include <chrono>
#include <optional>
#include <string>

#include "FakeSslInit.h"
#include "messagebus/amqp/AmqpConnection.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "errors/ErrorCodes.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// A connection without threads, over the fake TLS start-up library.
class BareConnection : public AmqpConnection {
public:
    BareConnection(AmqpConnectionManager* manager, int32_t port, bool useTls, std::string certPath,
                   int32_t connectTimeoutMs, SslInitLibrary& ssl)
        : AmqpConnection(manager, "guest", "guest", "127.0.0.1", port, "amq.test", useTls, "",
                         std::move(certPath), connectTimeoutMs, 30, ssl) {}
    void ReconnectLoop() override {}
    void ReaderLoop() override {}
};

// A loopback port that nothing listens on: bound once, then released.
int ClosedLoopbackPort() {
    const int fd = ::socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    ::bind(fd, reinterpret_cast<sockaddr*>(&address), sizeof address);
    ::getsockname(fd, reinterpret_cast<sockaddr*>(&address), &length);
    ::close(fd);
    return ntohs(address.sin_port);
}

std::optional<AmqpException> ConnectFailure(AmqpConnectionManager* manager, bool useTls,
                                            const std::string& certPath, int32_t timeoutMs) {
    SslInitLibrary ssl("libfake.so", Testing::FakeSslLoader());
    try {
        BareConnection connection(manager, ClosedLoopbackPort(), useTls, certPath, timeoutMs, ssl);
    } catch (const AmqpException& error) {
        EXPECT_EQ(ssl.Count(), 0);  // a failed construction gives its count back
        return error;
    }
    return std::nullopt;
}

TEST(AmqpConnection, RefusedConnectionFailsWithinItsTimeout) {
    Testing::fakeSsl = {};
    AmqpConnectionManager manager{VeldraConfiguration{}};
    for (const int32_t timeoutMs : {0, 300}) {
        const auto start = std::chrono::steady_clock::now();
        const auto failure = ConnectFailure(&manager, false, "", timeoutMs);
        const auto elapsed = std::chrono::steady_clock::now() - start;
        ASSERT_TRUE(failure.has_value());
        EXPECT_EQ(failure->Code(), ErrorCodes::kOpeningSocket);
        EXPECT_LT(failure->Status(), 0);
        EXPECT_EQ(std::string(failure->what()),
                  "Error opening TCP socket. RabbitMQ client (rabbitmq-c) status code: " +
                      std::to_string(failure->Status()));
        // The pause after a refused attempt ends at the deadline, not 5 s on.
        EXPECT_LT(elapsed, std::chrono::milliseconds(timeoutMs) + std::chrono::seconds(3));
        std::string line;
        ASSERT_TRUE(manager.TakeLog(line, 0));
        EXPECT_EQ(line, "Connecting to AMQP with " + std::to_string(timeoutMs) + "ms timeout...");
    }
    EXPECT_EQ(Testing::fakeSsl.uninits, 2);
}

// A peer that accepts the socket and never answers: the login ends with the
// connect time-out, not with rabbitmq-c's own 12 s handshake wait.
TEST(AmqpConnection, SilentPeerFailsTheLoginWithinTheConnectTimeout) {
    Testing::fakeSsl = {};
    const int listener = ::socket(AF_INET, SOCK_STREAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    socklen_t length = sizeof address;
    ASSERT_EQ(::bind(listener, reinterpret_cast<sockaddr*>(&address), length), 0);
    ASSERT_EQ(::getsockname(listener, reinterpret_cast<sockaddr*>(&address), &length), 0);
    ASSERT_EQ(::listen(listener, 4), 0);

    SslInitLibrary ssl("libfake.so", Testing::FakeSslLoader());
    const auto start = std::chrono::steady_clock::now();
    std::optional<AmqpException> failure;
    try {
        BareConnection connection(nullptr, ntohs(address.sin_port), false, "", 1000, ssl);
    } catch (const AmqpException& error) {
        failure = error;
    }
    const auto elapsed = std::chrono::steady_clock::now() - start;
    ::close(listener);
    ASSERT_TRUE(failure.has_value());
    EXPECT_EQ(failure->Code(), ErrorCodes::kFailedToLogIn);
    EXPECT_LT(elapsed, std::chrono::seconds(5));
}

TEST(AmqpConnection, MissingCaFileFailsBeforeAnyConnect) {
    const auto failure = ConnectFailure(nullptr, true, "/nonexistent/ca.pem", 100);
    ASSERT_TRUE(failure.has_value());
    EXPECT_EQ(failure->Code(), ErrorCodes::kSettingCACertificate);
    EXPECT_EQ(std::string(failure->what()),
              "Error setting CA certificate: /nonexistent/ca.pem. AMQP status " +
                  std::to_string(failure->Status()));
}

}  // namespace
}  // namespace Korvane::Veldra::MessageBus
