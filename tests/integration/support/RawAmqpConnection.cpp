#include "support/RawAmqpConnection.h"

#include <amqp_ssl_socket.h>
#include <amqp_tcp_socket.h>
#include <netinet/in.h>
#include <sys/socket.h>
#include <sys/time.h>

namespace Korvane::Veldra::Testing {
namespace {

timeval Timeout() {
    return timeval{RawAmqpConnection::kTimeoutSeconds, 0};
}

std::string BytesText(const amqp_bytes_t& bytes) {
    return std::string(static_cast<const char*>(bytes.bytes), bytes.len);
}

}  // namespace

RawAmqpConnection::RawAmqpConnection() : state_(amqp_new_connection()) {
    if (state_ != nullptr) {
        const timeval timeout = Timeout();
        amqp_set_rpc_timeout(state_, &timeout);
    }
}

RawAmqpConnection::~RawAmqpConnection() {
    if (state_ == nullptr) {
        return;
    }
    if (loggedIn_) {
        amqp_connection_close(state_, AMQP_REPLY_SUCCESS);
    }
    amqp_destroy_connection(state_);
}

int RawAmqpConnection::Open(amqp_socket_t* socket, const std::string& host, int port) {
    timeval timeout = Timeout();
    return amqp_socket_open_noblock(socket, host.c_str(), port, &timeout);
}

int RawAmqpConnection::OpenTcp(const std::string& host, int port) {
    amqp_socket_t* socket = state_ != nullptr ? amqp_tcp_socket_new(state_) : nullptr;
    return socket == nullptr ? AMQP_STATUS_NO_MEMORY : Open(socket, host, port);
}

int RawAmqpConnection::OpenTls(const std::string& host, int port, const std::string& caPath,
                               bool verifyHostname) {
    amqp_socket_t* socket = state_ != nullptr ? amqp_ssl_socket_new(state_) : nullptr;
    if (socket == nullptr) {
        return AMQP_STATUS_NO_MEMORY;
    }
    amqp_ssl_socket_set_verify_peer(socket, 1);
    amqp_ssl_socket_set_verify_hostname(socket, verifyHostname ? 1 : 0);
    const int status = amqp_ssl_socket_set_cacert(socket, caPath.c_str());
    return status != AMQP_STATUS_OK ? status : Open(socket, host, port);
}

::testing::AssertionResult RawAmqpConnection::Login(const std::string& user,
                                                    const std::string& password) {
    const amqp_rpc_reply_t reply = amqp_login(state_, "/", 0, 131072, 0, AMQP_SASL_METHOD_PLAIN,
                                              user.c_str(), password.c_str());
    loggedIn_ = reply.reply_type == AMQP_RESPONSE_NORMAL;
    return IsNormal(reply);
}

::testing::AssertionResult RawAmqpConnection::OpenChannel(amqp_channel_t channel) {
    amqp_channel_open(state_, channel);
    return IsNormal(amqp_get_rpc_reply(state_));
}

int RawAmqpConnection::LocalPort() const {
    const int fd = state_ != nullptr ? amqp_get_sockfd(state_) : -1;
    sockaddr_in address{};
    socklen_t length = sizeof address;
    if (fd < 0 || getsockname(fd, reinterpret_cast<sockaddr*>(&address), &length) != 0) {
        return 0;
    }
    return ntohs(address.sin_port);
}

std::string ReplyText(const amqp_rpc_reply_t& reply) {
    switch (reply.reply_type) {
        case AMQP_RESPONSE_NORMAL:
            return "normal";
        case AMQP_RESPONSE_NONE:
            return "no reply";
        case AMQP_RESPONSE_LIBRARY_EXCEPTION:
            return std::string("library error: ") + amqp_error_string2(reply.library_error);
        case AMQP_RESPONSE_SERVER_EXCEPTION:
            break;
    }
    if (reply.reply.id == AMQP_CONNECTION_CLOSE_METHOD) {
        const auto* close = static_cast<const amqp_connection_close_t*>(reply.reply.decoded);
        return "connection closed by the server: " + std::to_string(close->reply_code) + " " +
               BytesText(close->reply_text);
    }
    if (reply.reply.id == AMQP_CHANNEL_CLOSE_METHOD) {
        const auto* close = static_cast<const amqp_channel_close_t*>(reply.reply.decoded);
        return "channel closed by the server: " + std::to_string(close->reply_code) + " " +
               BytesText(close->reply_text);
    }
    return "server exception, method " + std::to_string(reply.reply.id);
}

::testing::AssertionResult IsNormal(const amqp_rpc_reply_t& reply) {
    if (reply.reply_type == AMQP_RESPONSE_NORMAL) {
        return ::testing::AssertionSuccess();
    }
    return ::testing::AssertionFailure() << ReplyText(reply);
}

}  // namespace Korvane::Veldra::Testing
