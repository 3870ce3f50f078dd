#include "support/RawServiceClient.h"

#include <unistd.h>

#include <atomic>
#include <stdexcept>

#include "messagelibrary/AmqpPropertyMapping.h"
#include "support/RawAmqp.h"

namespace Korvane::Veldra::Bench {
namespace {

constexpr int kReplyTimeoutSeconds = 10;

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

RawServiceClient::RawServiceClient(const BrokerAddress& broker, const std::string& exchange,
                                   bool handOff)
    : state_(OpenRawConnection(broker)), exchange_(exchange), name_(NewClientName()) {
    try {
        const std::string key = "Veldra." + name_ + ".#";
        amqp_queue_declare(state_, 1, amqp_cstring_bytes(name_.c_str()), 0, 0, 0, 1,
                           amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "queue.declare");
        amqp_queue_bind(state_, 1, amqp_cstring_bytes(name_.c_str()),
                        amqp_cstring_bytes(exchange.c_str()), amqp_cstring_bytes(key.c_str()),
                        amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "queue.bind");
        amqp_basic_consume(state_, 1, amqp_cstring_bytes(name_.c_str()), amqp_empty_bytes, 0, 1, 0,
                           amqp_empty_table);
        CheckRawReply(amqp_get_rpc_reply(state_), "basic.consume");
        if (handOff) {
            publisher_ = OpenRawConnection(broker);
            reader_ = std::thread([this] { ReadReplies(); });
        }
    } catch (...) {
        if (publisher_ != nullptr) amqp_destroy_connection(publisher_);
        amqp_destroy_connection(state_);
        throw;
    }
}

RawServiceClient::~RawServiceClient() {
    stop_ = true;
    if (reader_.joinable()) reader_.join();
    if (publisher_ != nullptr) CloseRawConnection(publisher_);
    CloseRawConnection(state_);
}

std::unique_ptr<RawServiceClient::Prepared> RawServiceClient::Prepare(
    MessageBus::MessageBase& message) const {
    return std::make_unique<Prepared>(message, name_);
}

void RawServiceClient::RoundTrip(const Prepared& message) {
    amqp_connection_state_t out = publisher_ != nullptr ? publisher_ : state_;
    if (amqp_basic_publish(out, 1, amqp_cstring_bytes(exchange_.c_str()),
                           amqp_cstring_bytes(message.routingKey.c_str()), 0, 0,
                           message.properties.Get(),
                           amqp_cstring_bytes(message.body.c_str())) != 0) {
        throw std::runtime_error("rabbitmq-c failed: basic.publish");
    }
    if (publisher_ != nullptr) {
        if (!replies_.Acquire(kReplyTimeoutSeconds * 1000)) {
            throw std::runtime_error("no reply in time");
        }
        return;
    }
    amqp_maybe_release_buffers(state_);
    amqp_envelope_t envelope;
    timeval timeout{kReplyTimeoutSeconds, 0};
    CheckRawReply(amqp_consume_message(state_, &envelope, &timeout, 0), "consume");
    amqp_destroy_envelope(&envelope);
}

// Each reply wakes the caller; a time-out of the wait only looks at stop_.
// A failure ends the thread, and the caller then runs out of time.
void RawServiceClient::ReadReplies() {
    while (!stop_) {
        amqp_maybe_release_buffers(state_);
        amqp_envelope_t envelope;
        timeval timeout{0, 100000};
        const amqp_rpc_reply_t reply = amqp_consume_message(state_, &envelope, &timeout, 0);
        if (reply.reply_type == AMQP_RESPONSE_NORMAL) {
            amqp_destroy_envelope(&envelope);
            replies_.Release();
        } else if (reply.reply_type != AMQP_RESPONSE_LIBRARY_EXCEPTION ||
                   reply.library_error != AMQP_STATUS_TIMEOUT) {
            return;
        }
    }
}

}  // namespace Korvane::Veldra::Bench
