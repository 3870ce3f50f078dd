#include "messagebus/amqp/AmqpPollingConnection.h"

#include <algorithm>
#include <utility>

#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpFrames.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// The reconnect thread looks at the watchdog this often.
constexpr uint32_t kWatchPeriodMs = 1000;
// The pause between two failed attempts to connect again.
constexpr uint32_t kReconnectRetryMs = 500;

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
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    const auto found = Channels.find(envelope->channel);
    if (found == Channels.end()) {
        // Dropped unacknowledged.
        Log(NoConsumerLine(texts_.owner, envelope->channel));
        return;
    }
    found->second->Envelopes->Add(envelope);
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
    if (const auto closed = FindChannel(channel)) {
        Log("AMQP channel was unexpectedly closed.");
        closed->ChannelReset.Release();
    }
}

void AmqpPollingConnection::LibraryFailure(int status) {
    Log(LibraryExceptionLine(status));
    Disconnect();
}

void AmqpPollingConnection::Disconnect() {
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
            Log(texts_.reconnecting);
            // A failed attempt is tried again after a pause, for as long as
            // the connection is meant to run: a broker that is down when the
            // first attempt comes (a node restart, an application stop) must
            // not leave the connection broken for good. The pause ends early
            // on a stop or a new request to reconnect.
            while (!Reconnect() && !StopRequested) {
                ReconnectSignal.Acquire(kReconnectRetryMs);
                if (StopRequested) return;
                Log(texts_.reconnecting);
            }
        }
    } catch (const std::exception& error) {
        // The wait itself failed: nothing here can go on.
        ReportError(VeldraException(ErrorCodes::kException, error.what()));
    }
}

bool AmqpPollingConnection::Reconnect() {
    try {
        Disconnected = true;
        WakeSignal.Release();
        Reader.Join(ReaderThread, Watchdog);
        Disconnected = false;
        Connect();
        OnReconnected();
        StartReader();
        return true;
    } catch (const VeldraException& error) {
        if (!StopRequested) ReportError(error);
    } catch (const std::exception& error) {
        if (!StopRequested) ReportError(VeldraException(ErrorCodes::kException, error.what()));
    }
    return false;
}

}  // namespace Korvane::Veldra::MessageBus
