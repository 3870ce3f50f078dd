#include "support/BusSniffer.h"

#include <sys/time.h>

#include "support/BrokerEnvironment.h"

namespace Korvane::Veldra::Testing {
namespace {

constexpr amqp_channel_t kChannel = 1;

bool IsClose(const amqp_frame_t& frame) {
    return frame.frame_type == AMQP_FRAME_METHOD &&
           (frame.payload.method.id == AMQP_CHANNEL_CLOSE_METHOD ||
            frame.payload.method.id == AMQP_CONNECTION_CLOSE_METHOD);
}

}  // namespace

BusSniffer::BusSniffer(const std::string& exchange) {
    const BrokerSettings& broker = Broker();
    const int opened = connection_.OpenTcp(broker.Host, broker.AmqpPort);
    if (opened != AMQP_STATUS_OK) {
        ADD_FAILURE() << "BusSniffer: connecting to " << broker.Host << ":" << broker.AmqpPort
                      << ": " << amqp_error_string2(opened);
        return;
    }
    if (!Step("logging in", connection_.Login(broker.User, broker.Password)) ||
        !Step("opening its channel", connection_.OpenChannel(kChannel))) {
        return;
    }
    amqp_connection_state_t state = connection_.Get();
    const amqp_bytes_t exchangeName = amqp_cstring_bytes(exchange.c_str());
    // Declared as the library declares it, so that the sniffer may come first;
    // the broker's own "amq." exchanges always exist and refuse a declare.
    if (exchange.rfind("amq.", 0) != 0) {
        amqp_exchange_declare(state, kChannel, exchangeName, amqp_cstring_bytes("topic"), 0, 1, 0,
                              0, amqp_empty_table);
        if (!Step("declaring the exchange", IsNormal(amqp_get_rpc_reply(state)))) return;
    }
    const amqp_queue_declare_ok_t* declared =
        amqp_queue_declare(state, kChannel, amqp_empty_bytes, 0, 0, 1, 1, amqp_empty_table);
    if (!Step("declaring its queue", IsNormal(amqp_get_rpc_reply(state)))) return;
    const std::string queue(static_cast<const char*>(declared->queue.bytes), declared->queue.len);
    const amqp_bytes_t queueName = amqp_cstring_bytes(queue.c_str());
    amqp_queue_bind(state, kChannel, queueName, exchangeName, amqp_cstring_bytes("#"),
                    amqp_empty_table);
    if (!Step("binding its queue", IsNormal(amqp_get_rpc_reply(state)))) return;
    amqp_basic_consume(state, kChannel, queueName, amqp_empty_bytes, 0, 1, 1, amqp_empty_table);
    ready_ = Step("starting to consume", IsNormal(amqp_get_rpc_reply(state)));
}

bool BusSniffer::Step(const char* what, const ::testing::AssertionResult& result) {
    if (!result) ADD_FAILURE() << "BusSniffer: " << what << ": " << result.message();
    return static_cast<bool>(result);
}

std::string BusSniffer::WaitForBody(const std::string& needle, std::chrono::milliseconds timeout) {
    using Clock = std::chrono::steady_clock;
    const Clock::time_point deadline = Clock::now() + timeout;
    amqp_connection_state_t state = connection_.Get();
    while (ready_) {
        const auto left =
            std::chrono::duration_cast<std::chrono::microseconds>(deadline - Clock::now()).count();
        if (left <= 0) return "";
        timeval wait{};
        wait.tv_sec = static_cast<time_t>(left / 1000000);
        wait.tv_usec = static_cast<suseconds_t>(left % 1000000);
        amqp_maybe_release_buffers(state);
        amqp_envelope_t envelope{};
        const amqp_rpc_reply_t reply = amqp_consume_message(state, &envelope, &wait, 0);
        if (reply.reply_type == AMQP_RESPONSE_NORMAL) {
            const amqp_bytes_t& bytes = envelope.message.body;
            std::string body(static_cast<const char*>(bytes.bytes), bytes.len);
            amqp_destroy_envelope(&envelope);
            if (body.find(needle) != std::string::npos) return body;
            continue;
        }
        if (reply.reply_type == AMQP_RESPONSE_LIBRARY_EXCEPTION) {
            if (reply.library_error == AMQP_STATUS_TIMEOUT) return "";
            // A frame other than a delivery waits: read it; only a close ends the sniffer.
            amqp_frame_t frame{};
            if (reply.library_error == AMQP_STATUS_UNEXPECTED_STATE &&
                amqp_simple_wait_frame_noblock(state, &frame, &wait) == AMQP_STATUS_OK &&
                !IsClose(frame)) {
                continue;
            }
        }
        ADD_FAILURE() << "BusSniffer: consuming stopped: " << ReplyText(reply);
        ready_ = false;
    }
    return "";
}

}  // namespace Korvane::Veldra::Testing
