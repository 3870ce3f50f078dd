#pragma once

#include <amqp.h>

#include <atomic>
#include <chrono>
#include <condition_variable>
#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <thread>
#include <unordered_map>
#include <unordered_set>

#include "errors/AmqpException.h"
#include "messagebus/amqp/AmqpChannel.h"
#include "messagebus/amqp/AmqpGate.h"
#include "messagebus/amqp/SocketWatchdog.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagebus/amqp/SslInitLibrary.h"

namespace Korvane::Veldra::MessageBus {

class AmqpConnectionManager;

// One rabbitmq-c connection to the broker and the channels opened on it. The
// publisher and the consumer connection derive from it and add the reader and
// reconnect threads. The constructor connects; every AMQP call runs under the
// gate, which gives control operations and publishes precedence over the
// reader's next poll.
class AmqpConnection {
public:
    // A negative connectTimeoutMs waits without limit.
    AmqpConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                   std::string host, int32_t port, std::string exchangeName, bool useTls,
                   std::string tlsServerName, std::string certPath, int32_t connectTimeoutMs,
                   int32_t heartbeatSeconds);
    AmqpConnection(const AmqpConnection&) = delete;
    AmqpConnection& operator=(const AmqpConnection&) = delete;

    // Opens the lowest free channel number from 1, records it, and declares
    // the exchange on the first channel of this connection object.
    virtual std::shared_ptr<AmqpChannel> CreateChannel();
    // Forgets the channel and closes its AMQP channel, so that its number can
    // be taken again.
    virtual void CloseChannel(uint16_t channelId);
    // Closes the connection, if any, then releases the TLS start-up library.
    virtual ~AmqpConnection();
    // The body of the reconnect thread.
    virtual void ReconnectLoop() = 0;
    // The body of the reader thread.
    virtual void ReaderLoop() = 0;

    // Opens the socket, logs in, and opens every recorded channel again with
    // its number, trying until the connect time-out has passed. The new
    // connection is made without the gate, which is taken only to put it in
    // place.
    void Connect();
    void OpenChannel(uint16_t channelId);
    // The topic exchange ExchangeName: durable, not auto-deleted, not internal.
    void DeclareExchange(uint16_t channelId);
    void SetQos(uint16_t channelId, uint32_t prefetchSize, uint16_t prefetchCount, bool global);
    // Closes with 200 and destroys the connection state. The close handshake
    // is skipped when the socket cannot take the close at once, and the
    // broker's answer is awaited for a few seconds at most.
    void CloseConnection();

    // The text form of a reply, as it appears in the failure texts.
    static std::string ReplyText(const amqp_rpc_reply_t& reply);

    const std::string& GetExchangeName() const { return ExchangeName; }
    // The recorded channel of a number, or null.
    std::shared_ptr<AmqpChannel> FindChannel(uint16_t channelId) const;
    bool IsConnected() const;
    // True from the moment a reader found the connection lost until a new
    // one is in place. Read without the gate.
    bool IsLost() const { return ConnectionLost.load(); }
    // Waits up to `timeout` while the connection is lost; true once it is
    // connected again (at once when it is not lost).
    bool WaitUntilConnected(std::chrono::milliseconds timeout);

protected:
    // As the public constructor, with the TLS start-up library given: tests
    // use one that does not load the platform's library.
    AmqpConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                   std::string host, int32_t port, std::string exchangeName, bool useTls,
                   std::string tlsServerName, std::string certPath, int32_t connectTimeoutMs,
                   int32_t heartbeatSeconds, SslInitLibrary& sslLibrary);

    // Guards for the gate: ControlGateGuard around every control operation
    // and publish; ReaderGateGuard around one poll of a reader thread.
    using ControlGateGuard = AmqpGate::Control;
    using ReaderGateGuard = AmqpGate::Reader;

    // Sets StopRequested and cuts short the wait between connect attempts, so
    // a Connect in progress ends at its current attempt.
    void RequestStop();
    // As Connect, with one attempt to open the socket: the reconnect thread
    // makes the pauses between attempts itself.
    void ConnectOnce();
    // Shuts the socket of a lost connection down, so that a call still blocked
    // on it returns, and destroys the connection. Only the thread that
    // replaces connections calls it.
    void DropConnection();

    // A status line to the manager's log (nothing without a manager).
    void Log(const std::string& line) const;
    // Hands an error that has no caller to the manager's last error.
    void ReportError(const VeldraException& error) const;

    // How long one socket call may run before the watchdog shuts its socket
    // down: one heartbeat interval, after which the broker itself gives a
    // silent peer up. A method call that waits for the broker's answer (an
    // RPC) gives up after half of it, so that it ends, and rabbitmq-c closes
    // the socket, before the watchdog would cut it.
    std::chrono::steady_clock::duration StallLimit() const;

    // Sends the declaration of the topic exchange ExchangeName on the
    // channel; the caller reads the reply.
    void SendExchangeDeclare(amqp_connection_state_t state, uint16_t channelId) const;
    // The start of the text of a failed exchange declaration.
    std::string DeclareExchangeContext(uint16_t channelId) const;

    // Throws AmqpException(code, context + ReplyText(reply), library_error)
    // unless the reply is normal.
    static void CheckReply(const amqp_rpc_reply_t& reply, int32_t code, const std::string& context);
    // The reply of the last method call on Connection; "no reply" without a
    // connection. Call with the gate held.
    amqp_rpc_reply_t LastReply() const;
    // Throws AmqpException(code, context + "No AMQP Response") when there is
    // no connection. Call with the gate held.
    void RequireConnection(int32_t code, const std::string& context) const;

    // ---- The design's fields ----
    std::unordered_map<uint16_t, std::shared_ptr<AmqpChannel>> Channels;
    amqp_connection_state_t Connection = nullptr;
    amqp_socket_t* Socket = nullptr;
    const int32_t ConnectTimeoutMs;
    const int32_t HeartbeatSeconds;
    const std::string User;
    const std::string Password;
    const std::string Host;
    const int32_t Port;
    const std::string ExchangeName;
    const bool UseTls;
    const std::string TlsServerName;  // kept; no step reads it
    const std::string CertPath;
    bool ExchangeDeclared = false;
    mutable std::recursive_mutex ChannelMutex;
    AmqpConnectionManager* const Manager;
    std::mutex StartMutex;
    std::atomic<bool> StopRequested{false};
    std::atomic<bool> Disconnected{false};
    std::unique_ptr<std::thread> ReconnectThread;
    std::unique_ptr<std::thread> ReaderThread;
    Semaphore ReconnectSignal;
    Semaphore WakeSignal;
    // GateMutex, GateWaiters and GateIdle.
    mutable AmqpGate Gate;
    // Every call on the socket runs inside one of its scopes; the reconnect
    // thread of a polling connection keeps it.
    SocketWatchdog Watchdog;
    // Set by a reader that found the connection lost, cleared when a new one
    // is in place: calls that would only meet the dead socket fail at once.
    std::atomic<bool> ConnectionLost{false};
    // Notified, with RestoredMutex, when a new connection is in place.
    std::mutex RestoredMutex;
    std::condition_variable Restored;
    // Channels that the broker closed on the current connection and that were
    // answered with close-ok; a new connection opens every channel again.
    // Guarded by the gate.
    std::unordered_set<uint16_t> ClosedChannels;

private:
    // Connect and ConnectOnce: builds, opens and logs in a connection of its
    // own, opens the recorded channels on it, then puts it in place.
    void Establish(bool untilDeadline);
    // Opens the socket within the time-out rules; returns the last status.
    int OpenSocket(amqp_socket_t* socket);
    // One attempt of at most the longest attempt time.
    int OpenSocketOnce(amqp_socket_t* socket);
    // Sleeps for up to the given time, less when a stop is requested.
    void PauseBetweenAttempts(std::chrono::steady_clock::duration pause);
    // Builds the TLS or TCP socket on the new connection state.
    amqp_socket_t* NewSocket(amqp_connection_state_t state);
    [[noreturn]] void ThrowOpenFailure(int status) const;
    // OpenChannel and DeclareExchange on a given connection state.
    static void OpenChannelOn(amqp_connection_state_t state, uint16_t channelId);
    void DeclareExchangeOn(amqp_connection_state_t state, uint16_t channelId);

    SslInitLease SslLease;
    std::mutex PauseMutex;
    std::condition_variable PauseWake;
};

}  // namespace Korvane::Veldra::MessageBus
