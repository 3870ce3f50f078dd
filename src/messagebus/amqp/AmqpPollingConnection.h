#pragma once

#include <sys/time.h>

#include <chrono>
#include <cstdint>
#include <string>
#include <vector>

#include "messagebus/amqp/AmqpConnection.h"
#include "messagebus/concurrency/ResetEvent.h"

namespace Korvane::Veldra::MessageBus {

// What the publisher and the consumer connection share: a reader thread that
// polls the socket and sorts what arrives, and a reconnect thread that waits
// for the reader's signal and connects anew. The reconnect thread also keeps
// the socket watchdog of the base: a socket call that runs longer than
// StallLimit() has its socket shut down.
class AmqpPollingConnection : public AmqpConnection {
public:
    using Clock = std::chrono::steady_clock;

    // The lines that differ between the two connections.
    struct Texts {
        const char* reconnecting;      // logged before each reconnect
        const char* connectionClosed;  // logged on connection.close
        const char* owner;             // names the connection in the no-consumer line
    };

    // Waits for the reader's signal, connects anew and restarts the reader.
    // A failed attempt goes to the manager's last error and is tried again
    // after a pause that doubles from 100 ms up to kLongestReconnectPauseMs,
    // until it succeeds or the connection is stopped.
    void ReconnectLoop() override;

    static constexpr uint32_t kLongestReconnectPauseMs = 2000;

protected:
    AmqpPollingConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                          std::string host, int32_t port, std::string exchangeName, bool useTls,
                          std::string tlsServerName, std::string certPath, int32_t connectTimeoutMs,
                          int32_t heartbeatSeconds, SslInitLibrary& sslLibrary, Texts texts);
    ~AmqpPollingConnection() override = default;

    enum class PollOutcome {
        Delivered,     // an envelope arrived
        Idle,          // nothing arrived within the time-out
        Handled,       // another frame arrived and was acted on
        Failed,        // the connection is lost; a reconnect is under way
        NotConnected,  // there is no connection to poll
    };
    // Takes the gate as a reader for one amqp_consume_message with the
    // time-out and the action its reply asks for. The notices of returned
    // messages are handed on after the gate is released.
    PollOutcome PollOnce(const timeval& timeout);

    // Starts the reader, then the reconnect thread. Call with StartMutex held
    // and no threads running.
    void StartThreads();
    // Ends the reconnect thread, then the reader. Call with StartMutex held
    // and the threads running.
    void StopThreads();
    // Marks the connection lost and asks for a reconnect.
    void Disconnect();
    // Called by Disconnect, on the reader's thread, often with the gate held.
    virtual void OnConnectionLost() {}
    // Called by the reconnect thread after a successful Connect, before the
    // new reader starts.
    virtual void OnReconnected() {}
    // Where the notice of a returned message goes.
    virtual void DeliverReturnedMessage(const ResetEvent& event) = 0;
    // The broker closed the channel; called by the reader with the gate held.
    // Answers with close-ok and marks the channel closed, logs, and posts
    // the channel's reset.
    virtual void OnChannelClosed(amqp_channel_t channel);

    // ---- Channels the broker closed. Call with the gate held. ----
    // Sends channel.close-ok and marks the channel closed.
    void AnswerChannelClose(uint16_t channelId);
    // Opens a channel the broker closed on this connection again; true when
    // it had been closed.
    bool ReopenIfClosed(uint16_t channelId);
    bool IsClosed(uint16_t channelId) const;
    // CheckReply for the last call on the channel; a channel.close in the
    // reply is answered first.
    void CheckChannelReply(uint16_t channelId, int32_t code, const std::string& context);

private:
    PollOutcome PollUnderGate(const timeval& timeout);
    void StartReader();
    // One attempt to connect again; false when it failed. A failure is
    // reported once the connection has been lost (since lostAt) for longer
    // than the connect time-out, as a first connect would have given up then.
    bool Reconnect(Clock::time_point lostAt);
    void Deliver(const EnvelopePtr& envelope);
    void HandleMethod(amqp_method_number_t method, amqp_channel_t channel);
    void LibraryFailure(int status);

    const Texts texts_;
    WatchedThread Reader;
    // Notices read during the current poll; reader thread only.
    std::vector<ResetEvent> Returned;
};

}  // namespace Korvane::Veldra::MessageBus
