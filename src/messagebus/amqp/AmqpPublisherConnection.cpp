#include "messagebus/amqp/AmqpPublisherConnection.h"

#include <new>
#include <utility>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpFrames.h"
#include "messagebus/amqp/AmqpPropertiesC.h"
#include "messagelibrary/AmqpPropertyMapping.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using std::chrono::milliseconds;

const AmqpPollingConnection::Texts kTexts{"Publisher connection attempting to reconnect to AMQP...",
                                          "AMQP publisher connection was unexpectedly closed.",
                                          "publisher connection"};

// While idle the reader polls at most this often.
constexpr milliseconds kIdlePollPeriod(1000);
constexpr uint32_t kWakeWaitMs = 100;
// The shortest non-zero time-out: the poll never waits, yet rabbitmq-c still
// compares its deadline with the broker's heartbeat deadline, which a zero
// time-out skips. So a broker that has gone silent is found here, before a
// publish runs into rabbitmq-c's unbounded wait for it.
constexpr timeval kPollTimeout{0, 1};

AmqpPublisherConnection::Clock::rep Now() {
    return AmqpPublisherConnection::Clock::now().time_since_epoch().count();
}

[[noreturn]] void ThrowPublishFailure(int status) {
    throw AmqpException(ErrorCodes::kPublishingMessage,
                        "Error publishing message. AMQP status: " + std::to_string(status), status);
}

}  // namespace

AmqpPublisherConnection::AmqpPublisherConnection(AmqpConnectionManager* manager, std::string user,
                                                 std::string password, std::string host,
                                                 int32_t port, std::string exchangeName,
                                                 bool useTls, std::string tlsServerName,
                                                 std::string certPath, int32_t connectTimeoutMs,
                                                 int32_t heartbeatSeconds)
    : AmqpPublisherConnection(manager, std::move(user), std::move(password), std::move(host), port,
                              std::move(exchangeName), useTls, std::move(tlsServerName),
                              std::move(certPath), connectTimeoutMs, heartbeatSeconds,
                              SslInitLibrary::Process()) {}

AmqpPublisherConnection::AmqpPublisherConnection(AmqpConnectionManager* manager, std::string user,
                                                 std::string password, std::string host,
                                                 int32_t port, std::string exchangeName,
                                                 bool useTls, std::string tlsServerName,
                                                 std::string certPath, int32_t connectTimeoutMs,
                                                 int32_t heartbeatSeconds,
                                                 SslInitLibrary& sslLibrary)
    : AmqpPollingConnection(manager, std::move(user), std::move(password), std::move(host), port,
                            std::move(exchangeName), useTls, std::move(tlsServerName),
                            std::move(certPath), connectTimeoutMs, heartbeatSeconds, sslLibrary,
                            kTexts) {
    Start();
}

AmqpPublisherConnection::~AmqpPublisherConnection() {
    try {
        Stop();
    } catch (...) {
        // The base closes the connection all the same.
    }
}

void AmqpPublisherConnection::Start() {
    std::lock_guard<std::mutex> lock(StartMutex);
    if (ReconnectThread) return;
    StartThreads();
}

void AmqpPublisherConnection::Stop() {
    std::lock_guard<std::mutex> lock(StartMutex);
    if (!ReconnectThread) return;
    StopThreads();
}

void AmqpPublisherConnection::Publish(uint16_t channelId, const MessageHeaders& envelope,
                                      const MessageBody& body, bool mandatory) {
    // Deliberate hardening: while the connection is lost the publish could
    // only fail, and would first wait for the gate behind calls that meet
    // the dead socket; a caller that must never block gets its error now.
    if (ConnectionLost) ThrowPublishFailure(AMQP_STATUS_CONNECTION_CLOSED);
    const AmqpProperties properties = ToAmqpProperties(envelope);
    const AmqpBasicProperties basicProperties(properties);
    amqp_bytes_t bodyBytes;
    bodyBytes.len = body.Length();
    bodyBytes.bytes = const_cast<char*>(body.Data());
    int status = AMQP_STATUS_CONNECTION_CLOSED;
    bool restored = false;
    {
        ControlGateGuard gate(Gate);
        if (Connection != nullptr && !ConnectionLost) {
            try {
                restored = RestoreClosedChannel(channelId);
            } catch (const AmqpException& error) {
                ThrowPublishFailure(error.Status() != 0 ? error.Status()
                                                        : AMQP_STATUS_CONNECTION_CLOSED);
            }
            SocketWatchdog::Scope watch(Watchdog, Connection);
            status =
                amqp_basic_publish(Connection, channelId, amqp_cstring_bytes(ExchangeName.c_str()),
                                   TextBytes(envelope.routingKey), mandatory ? 1 : 0, 0,
                                   basicProperties.Get(), bodyBytes);
        }
    }
    // The bindings of every queue went with a deleted exchange: the consumers
    // of this manager declare and bind again. Outside the gate, as the
    // manager reaches the other connection.
    if (restored && Manager != nullptr) Manager->ResetConsumerChannels();
    if (status != AMQP_STATUS_OK) ThrowPublishFailure(status);
    LastSend = Now();
}

bool AmqpPublisherConnection::RestoreClosedChannel(uint16_t channelId) {
    if (!ReopenIfClosed(channelId)) return false;
    Log("Reopened AMQP channel " + std::to_string(channelId) +
        " that the broker had closed; declaring the exchange again.");
    {
        SocketWatchdog::Scope watch(Watchdog, Connection);
        SendExchangeDeclare(Connection, channelId);
    }
    CheckChannelReply(channelId, ErrorCodes::kDeclaringExchange,
                      DeclareExchangeContext(channelId));
    return true;
}

void AmqpPublisherConnection::OnChannelClosed(amqp_channel_t channel) {
    AnswerChannelClose(channel);
    if (FindChannel(channel)) Log("AMQP channel was unexpectedly closed.");
}

void AmqpPublisherConnection::ReaderLoop() {
    try {
        LastPoll = Clock::now();
        LastSend = Now();
        PollPending = false;
        while (!Disconnected) ReaderStep();
    } catch (const std::bad_alloc&) {
        ReconnectSignal.Release();
    } catch (const std::exception& error) {
        // The wait for the wake signal failed; a new reader starts afresh.
        Log(std::string("Publisher reader stopped: ") + error.what());
        ReconnectSignal.Release();
    }
}

void AmqpPublisherConnection::PollSoon() {
    PollRequested = true;
    WakeSignal.Release();
}

void AmqpPublisherConnection::ReaderStep() {
    if (PollRequested.exchange(false) || PollPending || Clock::now() - LastPoll > kIdlePollPeriod) {
        Poll();
    }
    if (HeartbeatSeconds > 0) {
        const auto quiet = Clock::duration(Now() - LastSend.load());
        if (std::chrono::duration_cast<std::chrono::seconds>(quiet).count() > HeartbeatSeconds) {
            SendHeartbeat();
        }
    }
    if (!PollPending) WakeSignal.Acquire(kWakeWaitMs);
}

void AmqpPublisherConnection::Poll() {
    const PollOutcome outcome = PollOnce(kPollTimeout);
    LastPoll = Clock::now();
    PollPending = outcome != PollOutcome::Idle && outcome != PollOutcome::NotConnected;
}

void AmqpPublisherConnection::SendHeartbeat() {
    ReaderGateGuard gate(Gate);
    if (Connection != nullptr) {
        SocketWatchdog::Scope watch(Watchdog, Connection);
        amqp_frame_t heartbeat{};
        heartbeat.frame_type = AMQP_FRAME_HEARTBEAT;
        heartbeat.channel = 0;
        // A failed send shows at the next poll.
        amqp_send_frame(Connection, &heartbeat);
    }
    LastSend = Now();
}

void AmqpPublisherConnection::DeliverReturnedMessage(const ResetEvent& event) {
    if (Manager != nullptr) Manager->DeliverReturnEvent(event);
}

}  // namespace Korvane::Veldra::MessageBus
