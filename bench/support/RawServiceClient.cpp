#include "support/RawServiceClient.h"

#include <amqp_tcp_socket.h>
#include <unistd.h>

#include <atomic>
#include <stdexcept>

#include "messagelibrary/AmqpPropertyMapping.h"

namespace Korvane::Veldra::Bench {
namespace {

constexpr int kReplyTimeoutSeconds = 10;

void Check(amqp_rpc_reply_t reply, const char* what) {
    if (reply.reply_type != AMQP_RESPONSE_NORMAL) {
        throw std::runtime_error(std::string("rabbitmq-c failed: ") + what);
    }
}

// A name of its own for each client of the process, so that clients on
// several threads each get their own replies.
std::string NewClientName() {
    static std::atomic<int> clients{0};
    return "RawBench" + std::to_string(getpid()) + "_" + std::to_string(++clients);
}

MessageBus::MessageBase& Addressed(MessageBus::MessageBase& message, const std::string& replyTo) {
    message.EnsureIdentity();
    message.SetIgnoreResponse(false);
    message.Headers().SetReplyTo(replyTo);
    message.Headers().SetOrigin(replyTo);
    return message;
}

}  // namespace

RawServiceClient::Prepared::Prepared(MessageBus::MessageBase& message, const std::string& replyTo)
    : routingKey(Addressed(message, replyTo).RoutingKey()),
      body(message.Serialize().ToString()),
      record(MessageBus::ToAmqpProperties(message.Headers())),
      properties(record) {}

RawServiceClient::RawServiceClient(const BrokerAddress& broker, const std::string& exchange)
    : state_(amqp_new_connection()), exchange_(exchange), name_(NewClientName()) {
    amqp_socket_t* socket = amqp_tcp_socket_new(state_);
    if (socket == nullptr || amqp_socket_open(socket, broker.host.c_str(), broker.port) != 0) {
        amqp_destroy_connection(state_);
        throw std::runtime_error("cannot open a socket to the broker");
    }
    try {
        Check(amqp_login(state_, "/", 0, 131072, 0, AMQP_SASL_METHOD_PLAIN, broker.user.c_str(),
                         broker.password.c_str()),
              "login");
        amqp_channel_open(state_, 1);
        Check(amqp_get_rpc_reply(state_), "channel.open");
        const std::string key = "Veldra." + name_ + ".#";
        amqp_queue_declare(state_, 1, amqp_cstring_bytes(name_.c_str()), 0, 0, 0, 1,
                           amqp_empty_table);
        Check(amqp_get_rpc_reply(state_), "queue.declare");
        amqp_queue_bind(state_, 1, amqp_cstring_bytes(name_.c_str()),
                        amqp_cstring_bytes(exchange.c_str()), amqp_cstring_bytes(key.c_str()),
                        amqp_empty_table);
        Check(amqp_get_rpc_reply(state_), "queue.bind");
        amqp_basic_consume(state_, 1, amqp_cstring_bytes(name_.c_str()), amqp_empty_bytes, 0, 1, 0,
                           amqp_empty_table);
        Check(amqp_get_rpc_reply(state_), "basic.consume");
    } catch (...) {
        amqp_destroy_connection(state_);
        throw;
    }
}

RawServiceClient::~RawServiceClient() {
    amqp_channel_close(state_, 1, AMQP_REPLY_SUCCESS);
    amqp_connection_close(state_, AMQP_REPLY_SUCCESS);
    amqp_destroy_connection(state_);
}

std::unique_ptr<RawServiceClient::Prepared> RawServiceClient::Prepare(
    MessageBus::MessageBase& message) const {
    return std::make_unique<Prepared>(message, name_);
}

void RawServiceClient::RoundTrip(const Prepared& message) {
    if (amqp_basic_publish(state_, 1, amqp_cstring_bytes(exchange_.c_str()),
                           amqp_cstring_bytes(message.routingKey.c_str()), 0, 0,
                           message.properties.Get(),
                           amqp_cstring_bytes(message.body.c_str())) != 0) {
        throw std::runtime_error("rabbitmq-c failed: basic.publish");
    }
    amqp_maybe_release_buffers(state_);
    amqp_envelope_t envelope;
    timeval timeout{kReplyTimeoutSeconds, 0};
    Check(amqp_consume_message(state_, &envelope, &timeout, 0), "consume");
    amqp_destroy_envelope(&envelope);
}

}  // namespace Korvane::Veldra::Bench
