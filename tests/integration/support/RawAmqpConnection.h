#pragma once

#include <amqp.h>
#include <gtest/gtest.h>

#include <string>

namespace Korvane::Veldra::Testing {

// One rabbitmq-c connection for tests that talk to the broker directly. Every
// network wait is bounded by kTimeoutSeconds; the connection is closed and
// destroyed with the object.
class RawAmqpConnection {
public:
    static constexpr int kTimeoutSeconds = 15;

    RawAmqpConnection();
    ~RawAmqpConnection();
    RawAmqpConnection(const RawAmqpConnection&) = delete;
    RawAmqpConnection& operator=(const RawAmqpConnection&) = delete;

    // Open a plain or a TLS socket (peer verification on, against caPath);
    // both return the rabbitmq-c status, 0 on success.
    int OpenTcp(const std::string& host, int port);
    int OpenTls(const std::string& host, int port, const std::string& caPath, bool verifyHostname);

    ::testing::AssertionResult Login(const std::string& user, const std::string& password);
    ::testing::AssertionResult OpenChannel(amqp_channel_t channel);

    // The local port of the socket, which the broker shows in the connection's
    // name; 0 when there is none.
    int LocalPort() const;

    amqp_connection_state_t Get() const { return state_; }

private:
    int Open(amqp_socket_t* socket, const std::string& host, int port);

    amqp_connection_state_t state_;
    bool loggedIn_ = false;
};

// Text of a reply for failure messages: the library error or the server's
// close code and text.
std::string ReplyText(const amqp_rpc_reply_t& reply);

// Makes an AssertionResult of a reply: success for a normal one.
::testing::AssertionResult IsNormal(const amqp_rpc_reply_t& reply);

}  // namespace Korvane::Veldra::Testing
