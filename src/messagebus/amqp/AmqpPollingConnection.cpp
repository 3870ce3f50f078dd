#include "messagebus/amqp/AmqpPollingConnection.h"

#include <algorithm>
#include <utility>

#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpFrames.h"
#include "messagebus/concurrency/Backoff.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// The reconnect thread looks at the watchdog this often.
constexpr uint32_t kWatchPeriodMs = 1000;

void Drain(Semaphore& semaphore) {
    while (semaphore.Acquire(0)) {
    }
}

}  // namespace

AmqpPollingConnection::AmqpPollingConnection(AmqpConnectionManager* manager, std::string user,
                                             std::string password, std::string host, int32_t port,
                                             std::string exchangeName, bool useTls,
                                             std::string tlsServerName, std::string certPath,
                                             int32_t connectTimeoutMs, int32_t heartbeatSeconds,
                                             SslInitLibrary& sslLibrary, Texts texts)
    : AmqpConnection(manager, std::move(user), std::move(password), std::move(host), port,
                     std::move(exchangeName), useTls, std::move(tlsServerName), std::move(certPath),
                     connectTimeoutMs, heartbeatSeconds, sslLibrary),
      texts_(texts) {}

AmqpPollingConnection::PollOutcome AmqpPollingConnection::PollOnce(const timeval& timeout) {
    Returned.clear();
    const PollOutcome outcome = PollUnderGate(timeout);
    // Without the gate: the manager takes its own lock to pass them on.
    for (const ResetEvent& event : Returned) DeliverReturnedMessage(event);
    return outcome;
}

AmqpPollingConnection::PollOutcome AmqpPollingConnection::PollUnderGate(const timeval& timeout) {
    // Waiting control operations and publishes go first.
    ReaderGateGuard gate(Gate);
    if (Connection == nullptr) return PollOutcome::NotConnected;
    SocketWatchdog::Scope watch(Watchdog, Connection);
    amqp_maybe_release_buffers(Connection);
    const EnvelopePtr envelope = MakeEnvelope();
    timeval wait = timeout;
    const amqp_rpc_reply_t reply = amqp_consume_message(Connection, envelope.get(), &wait, 0);
    switch (reply.reply_type) {
        case AMQP_RESPONSE_NORMAL:
            Deliver(envelope);
            return PollOutcome::Delivered;
        case AMQP_RESPONSE_SERVER_EXCEPTION:
            // A close that came in the middle of a delivery's content.
            HandleMethod(reply.reply.id, envelope->channel);
            return PollOutcome::Handled;
        case AMQP_RESPONSE_LIBRARY_EXCEPTION:
            break;
        default:
            return PollOutcome::Idle;
    }
    switch (reply.library_error) {
        case AMQP_STATUS_TIMEOUT:
            return PollOutcome::Idle;
        case AMQP_STATUS_UNEXPECTED_STATE: {
            // A frame other than a delivery waits; the poll put it back.
            amqp_frame_t frame{};
            const int status = amqp_simple_wait_frame(Connection, &frame);
            if (status != AMQP_STATUS_OK) {
                LibraryFailure(status);
                return PollOutcome::Failed;
            }
            if (frame.frame_type == AMQP_FRAME_METHOD) {
                HandleMethod(frame.payload.method.id, frame.channel);
            }
            return PollOutcome::Handled;
        }
        default:
            LibraryFailure(reply.library_error);
            return PollOutcome::Failed;
    }
}

void AmqpPollingConnection::Deliver(const EnvelopePtr& envelope) {
    std::shared_ptr<AmqpChannel> channel;
    {
        std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
        const auto found = Channels.find(envelope->channel);
        if (found == Channels.end()) {
            // Dropped unacknowledged.
            Log(NoConsumerLine(texts_.owner, envelope->channel));
            return;
        }
        channel = found->second;
    }
    // A reply that a caller waits for goes to it from here, without waking
    // the channel's handling thread; everything else is queued for that thread.
    if (!channel->OfferDirect(envelope)) channel->Envelopes->Add(envelope);
}

void AmqpPollingConnection::HandleMethod(amqp_method_number_t method, amqp_channel_t channel) {
    switch (method) {
        case AmqpMethodIds::kChannelClose:
            OnChannelClosed(channel);
            break;
        case AmqpMethodIds::kConnectionClose:
            Log(texts_.connectionClosed);
            Disconnect();
            break;
        case AmqpMethodIds::kBasicReturn:
            if (auto event = ReadReturnedMessage(Connection, channel)) {
                Returned.push_back(std::move(*event));
            }
            break;
        case AmqpMethodIds::kBasicAck:
            break;
        default:
            Log(UnexpectedMethodLine(method));
            break;
    }
}

void AmqpPollingConnection::OnChannelClosed(amqp_channel_t channel) {
    AnswerChannelClose(channel);
    if (const auto closed = FindChannel(channel)) {
        Log("AMQP channel was unexpectedly closed.");
        closed->RequestReset();
    }
}

void AmqpPollingConnection::AnswerChannelClose(uint16_t channelId) {
    // Until the close-ok the broker drops every frame on the channel, and a
    // call sent there would wait for its answer until the watchdog cut the
    // whole connection.
    amqp_channel_close_ok_t closeOk{};
    const int status =
        amqp_send_method(Connection, channelId, AMQP_CHANNEL_CLOSE_OK_METHOD, &closeOk);
    if (status != AMQP_STATUS_OK) {
        // The socket is failing: the reader's next poll starts a reconnect.
        Log(LibraryExceptionLine(status));
        return;
    }
    ClosedChannels.insert(channelId);
}

bool AmqpPollingConnection::ReopenIfClosed(uint16_t channelId) {
    if (ClosedChannels.count(channelId) == 0) return false;
    OpenChannel(channelId);
    ClosedChannels.erase(channelId);
    return true;
}

bool AmqpPollingConnection::IsClosed(uint16_t channelId) const {
    return ClosedChannels.count(channelId) != 0;
}

void AmqpPollingConnection::CheckChannelReply(uint16_t channelId, int32_t code,
                                              const std::string& context) {
    const amqp_rpc_reply_t reply = LastReply();
    if (reply.reply_type == AMQP_RESPONSE_NORMAL) return;
    // The text first: the answer may reuse what the reply points into.
    const AmqpException error(code, context + ReplyText(reply), reply.library_error);
    if (reply.reply_type == AMQP_RESPONSE_SERVER_EXCEPTION &&
        reply.reply.id == AMQP_CHANNEL_CLOSE_METHOD) {
        AnswerChannelClose(channelId);
    }
    throw error;
}

void AmqpPollingConnection::LibraryFailure(int status) {
    Log(LibraryExceptionLine(status));
    Disconnect();
}

void AmqpPollingConnection::Disconnect() {
    ConnectionLost = true;
    OnConnectionLost();
    Disconnected = true;
    ReconnectSignal.Release();
}

void AmqpPollingConnection::StartReader() {
    Reader.Start(ReaderThread, [this] { ReaderLoop(); });
}

void AmqpPollingConnection::StartThreads() {
    StopRequested = false;
    Disconnected = false;
    // Signals left over from the last run would start a reconnect at once.
    Drain(ReconnectSignal);
    Drain(WakeSignal);
    StartReader();
    try {
        ReconnectThread = std::make_unique<std::thread>([this] { ReconnectLoop(); });
    } catch (...) {
        Disconnected = true;
        WakeSignal.Release();
        Reader.Join(ReaderThread, Watchdog);
        throw;
    }
}

void AmqpPollingConnection::StopThreads() {
    RequestStop();
    ReconnectSignal.Release();
    ReconnectThread->join();
    ReconnectThread.reset();
    Disconnected = true;
    WakeSignal.Release();
    Reader.Join(ReaderThread, Watchdog);
}

void AmqpPollingConnection::ReconnectLoop() {
    try {
        while (!StopRequested) {
            if (!ReconnectSignal.Acquire(kWatchPeriodMs)) {
                Watchdog.CutIfStalled(StallLimit());
                continue;
            }
            if (StopRequested) return;
            // Deliberate hardening: a failed attempt is tried again, for as
            // long as the connection is meant to run, so that a broker that is
            // down when the first attempt comes (a node restart, an
            // application stop) does not leave the connection broken for
            // good. Each attempt opens the socket once; the pauses between
            // them grow, so that a broker that refuses at once costs no CPU,
            // and stay short enough to find a broker soon after it is back.
            // A stop ends a pause early.
            Backoff backoff(Backoff::kFirstMs, kLongestReconnectPauseMs);
            const Clock::time_point lostAt = Clock::now();
            Log(texts_.reconnecting);
            while (!Reconnect(lostAt)) {
                if (StopRequested) return;
                ReconnectSignal.Acquire(backoff.NextMs());
                if (StopRequested) return;
                Watchdog.CutIfStalled(StallLimit());
                Log(texts_.reconnecting);
            }
        }
    } catch (const std::exception& error) {
        // The wait itself failed: nothing here can go on.
        ReportError(VeldraException(ErrorCodes::kException, error.what()));
    }
}

bool AmqpPollingConnection::Reconnect(Clock::time_point lostAt) {
    const auto report = [&](const VeldraException& error) {
        const bool overdue = ConnectTimeoutMs >= 0 &&
                             Clock::now() - lostAt >= std::chrono::milliseconds(ConnectTimeoutMs);
        if (!StopRequested && overdue) ReportError(error);
    };
    try {
        Disconnected = true;
        WakeSignal.Release();
        Reader.Join(ReaderThread, Watchdog);
        Disconnected = false;
        DropConnection();
        ConnectOnce();
        OnReconnected();
        StartReader();
        return true;
    } catch (const VeldraException& error) {
        report(error);
    } catch (const std::exception& error) {
        report(VeldraException(ErrorCodes::kException, error.what()));
    }
    return false;
}

}  // namespace Korvane::Veldra::MessageBus
