#include "messagebus/amqp/AmqpConnection.h"

#include <amqp_ssl_socket.h>
#include <amqp_tcp_socket.h>
#include <netinet/in.h>
#include <netinet/tcp.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/time.h>

#include <algorithm>
#include <ctime>
#include <utility>
#include <vector>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpReplyText.h"
#include "messagebus/amqp/CaCertificate.h"
#include "messagebus/amqp/TlsSocketRules.h"
#include "messagebus/concurrency/Backoff.h"

namespace Korvane::Veldra::MessageBus {
namespace {

using std::chrono::milliseconds;
using std::chrono::steady_clock;

constexpr int kFrameMax = 131072;
constexpr int32_t kLongestAttemptMs = 10000;
constexpr auto kPauseAfterSocketError = std::chrono::seconds(5);
// The least time the AMQP handshake gets once the socket is open, so that a
// connect that used up its time-out on the socket still can log in.
constexpr milliseconds kShortestHandshake(250);

// A broker that goes silent without closing the socket would otherwise hold a
// blocked send or receive of rabbitmq-c, and the gate, without end: the
// socket is non-blocking and the library polls it with no limit in places.
// Keep-alive probes end the connection some 60 seconds after the peer stops
// answering, and unacknowledged data (a full send window included) after the
// same time.
constexpr int kKeepAliveIdleSeconds = 30;
constexpr int kKeepAliveIntervalSeconds = 10;
constexpr int kKeepAliveProbes = 3;
constexpr unsigned kUserTimeoutMs = 60000;

// The stall limit when heartbeats are off, and the least one.
constexpr int32_t kStallSecondsWithoutHeartbeat = 270;
constexpr int32_t kShortestStallSeconds = 5;
// The longest wait for the broker's close-ok: the connection goes either way.
constexpr milliseconds kLongestCloseWait(3000);

// The statuses after which another attempt can succeed; each has used up its
// attempt's time except a refused connection (socket error).
bool IsRetriedOpenStatus(int status) {
    switch (status) {
        case AMQP_STATUS_CONNECTION_CLOSED:
        case AMQP_STATUS_HOSTNAME_RESOLUTION_FAILED:
        case AMQP_STATUS_TIMEOUT:
        case AMQP_STATUS_SOCKET_ERROR:
        case AMQP_STATUS_SOCKET_CLOSED:
        case AMQP_STATUS_HEARTBEAT_TIMEOUT:
            return true;
        default:
            return false;
    }
}

void BoundSilentPeer(amqp_connection_state_t state) {
    const int fd = amqp_get_sockfd(state);
    if (fd < 0) return;
    const int on = 1;
    // Best effort: a socket that refuses an option keeps the library's waits.
    setsockopt(fd, SOL_SOCKET, SO_KEEPALIVE, &on, sizeof on);
    setsockopt(fd, IPPROTO_TCP, TCP_KEEPIDLE, &kKeepAliveIdleSeconds, sizeof(int));
    setsockopt(fd, IPPROTO_TCP, TCP_KEEPINTVL, &kKeepAliveIntervalSeconds, sizeof(int));
    setsockopt(fd, IPPROTO_TCP, TCP_KEEPCNT, &kKeepAliveProbes, sizeof(int));
    setsockopt(fd, IPPROTO_TCP, TCP_USER_TIMEOUT, &kUserTimeoutMs, sizeof(unsigned));
}

// rabbitmq-c waits 12 s for a peer that accepted the socket but never speaks
// AMQP; the login gets what is left of the connect time-out instead.
void BoundHandshake(amqp_connection_state_t state, steady_clock::time_point deadline) {
    const auto left = std::max(kShortestHandshake, std::chrono::duration_cast<milliseconds>(
                                                        deadline - steady_clock::now()));
    timeval timeout{static_cast<time_t>(left.count() / 1000),
                    static_cast<suseconds_t>((left.count() % 1000) * 1000)};
    amqp_set_handshake_timeout(state, &timeout);
}

void SetRpcTimeout(amqp_connection_state_t state, milliseconds timeout) {
    timeval value{static_cast<time_t>(timeout.count() / 1000),
                  static_cast<suseconds_t>((timeout.count() % 1000) * 1000)};
    amqp_set_rpc_timeout(state, &value);
}

// rabbitmq-c sends with no deadline and, on a partial send, reads with none
// either; a socket whose send buffer has no room now belongs to a peer that
// has stopped reading.
bool CanSendNow(amqp_connection_state_t state) {
    pollfd entry{amqp_get_sockfd(state), POLLOUT, 0};
    return entry.fd >= 0 && poll(&entry, 1, 0) == 1 && (entry.revents & POLLOUT) != 0 &&
           (entry.revents & (POLLERR | POLLHUP)) == 0;
}

struct ConnectionStateDeleter {
    void operator()(amqp_connection_state_t state) const { amqp_destroy_connection(state); }
};
using OwnedState = std::unique_ptr<amqp_connection_state_t_, ConnectionStateDeleter>;

std::string TimeoutText(int32_t timeoutMs) {
    return timeoutMs < 0 ? "infinite" : std::to_string(timeoutMs) + "ms";
}

}  // namespace

AmqpConnection::AmqpConnection(AmqpConnectionManager* manager, std::string user,
                               std::string password, std::string host, int32_t port,
                               std::string exchangeName, bool useTls, std::string tlsServerName,
                               std::string certPath, int32_t connectTimeoutMs,
                               int32_t heartbeatSeconds)
    : AmqpConnection(manager, std::move(user), std::move(password), std::move(host), port,
                     std::move(exchangeName), useTls, std::move(tlsServerName), std::move(certPath),
                     connectTimeoutMs, heartbeatSeconds, SslInitLibrary::Process()) {}

AmqpConnection::AmqpConnection(AmqpConnectionManager* manager, std::string user,
                               std::string password, std::string host, int32_t port,
                               std::string exchangeName, bool useTls, std::string tlsServerName,
                               std::string certPath, int32_t connectTimeoutMs,
                               int32_t heartbeatSeconds, SslInitLibrary& sslLibrary)
    : ConnectTimeoutMs(connectTimeoutMs),
      HeartbeatSeconds(heartbeatSeconds),
      User(std::move(user)),
      Password(std::move(password)),
      Host(std::move(host)),
      Port(port),
      ExchangeName(std::move(exchangeName)),
      UseTls(useTls),
      TlsServerName(std::move(tlsServerName)),
      CertPath(std::move(certPath)),
      Manager(manager),
      SslLease(sslLibrary) {
    // OpenSSL's start-up belongs to the platform library acquired above.
    amqp_set_initialize_ssl_library(0);
    Connect();
}

AmqpConnection::~AmqpConnection() {
    try {
        CloseConnection();
    } catch (...) {
        // A connection that cannot be closed is gone all the same.
    }
}

void AmqpConnection::Connect() {
    Establish(true);
}

void AmqpConnection::ConnectOnce() {
    Establish(false);
}

void AmqpConnection::Establish(bool untilDeadline) {
    Log("Connecting to AMQP with " + TimeoutText(ConnectTimeoutMs) + " timeout...");
    // Deliberate hardening: the socket is opened and the login made on a
    // connection state of its own, without the gate. Connect attempts can
    // last the whole connect time-out; a publish or a control call meanwhile
    // must fail at once on the lost connection, not wait behind them.
    OwnedState state(amqp_new_connection());
    if (!state) {
        throw AmqpException(ErrorCodes::kOpeningTCPConnection, "No TCP connection.", 0);
    }
    amqp_socket_t* socket = NewSocket(state.get());
    const auto started = steady_clock::now();
    const int status = untilDeadline ? OpenSocket(socket) : OpenSocketOnce(socket);
    if (status != AMQP_STATUS_OK) ThrowOpenFailure(status);

    BoundSilentPeer(state.get());
    if (!untilDeadline) {
        BoundHandshake(state.get(), steady_clock::now() + milliseconds(kLongestAttemptMs));
    } else if (ConnectTimeoutMs >= 0) {
        BoundHandshake(state.get(), started + milliseconds(ConnectTimeoutMs));
    }
    CheckReply(amqp_login(state.get(), "/", 0, kFrameMax, HeartbeatSeconds, AMQP_SASL_METHOD_PLAIN,
                          User.c_str(), Password.c_str()),
               ErrorCodes::kFailedToLogIn, "Error logging in to RabbitMQ. ");
    // Without it an RPC waits for its answer as long as heartbeats allow, or
    // for ever when they are off; the reconnect thread's own RPCs (the
    // channels opened again below) have nobody else to watch them.
    SetRpcTimeout(state.get(), std::chrono::duration_cast<milliseconds>(StallLimit() / 2));

    // The recorded channels keep their numbers on the new connection.
    std::vector<uint16_t> ids;
    bool declareExchange = false;
    {
        std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
        for (const auto& entry : Channels) ids.push_back(entry.first);
        declareExchange = ExchangeDeclared;
    }
    std::sort(ids.begin(), ids.end());
    for (const uint16_t id : ids) OpenChannelOn(state.get(), id);
    // Deliberate hardening: a node that restarted without its definitions has
    // lost the exchange, and every publish to it would close its channel, so
    // a connection that had declared it declares it again.
    if (declareExchange && !ids.empty()) DeclareExchangeOn(state.get(), ids.front());

    OwnedState replaced;
    {
        ControlGateGuard gate(Gate);
        std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
        // Channels made or closed on the old connection while this one was
        // being built: a number left open would be refused when it is taken
        // again.
        for (const auto& entry : Channels) {
            if (!std::binary_search(ids.begin(), ids.end(), entry.first)) {
                OpenChannelOn(state.get(), entry.first);
            }
        }
        for (const uint16_t id : ids) {
            if (Channels.count(id) == 0) amqp_channel_close(state.get(), id, AMQP_REPLY_SUCCESS);
        }
        replaced.reset(Connection);
        Connection = state.release();
        Socket = socket;
        ClosedChannels.clear();
        std::lock_guard<std::mutex> restored(RestoredMutex);
        ConnectionLost = false;
    }
    Restored.notify_all();
    // The old state goes outside the gate: nobody can reach it any more.
    replaced.reset();
    Log("Successfully connected to AMQP.");
}

bool AmqpConnection::WaitUntilConnected(std::chrono::milliseconds timeout) {
    std::unique_lock<std::mutex> lock(RestoredMutex);
    return Restored.wait_for(lock, timeout, [this] { return !ConnectionLost.load(); });
}

void AmqpConnection::DropConnection() {
    // Connection changes on this thread alone, so it may be read here
    // without the gate.
    if (Connection == nullptr) return;
    const int fd = amqp_get_sockfd(Connection);
    if (fd >= 0) shutdown(fd, SHUT_RDWR);
    // Gone before the new connection declares anything: the broker then ends
    // the old consumers, and deletes their auto-delete queues, before they
    // are declared again rather than after.
    ControlGateGuard gate(Gate);
    amqp_destroy_connection(Connection);
    Connection = nullptr;
    Socket = nullptr;
    ClosedChannels.clear();
}

amqp_socket_t* AmqpConnection::NewSocket(amqp_connection_state_t state) {
    if (!UseTls) {
        amqp_socket_t* socket = amqp_tcp_socket_new(state);
        if (socket == nullptr) {
            throw AmqpException(ErrorCodes::kCreatingTCPSocket, "Error creating TCP socket.");
        }
        return socket;
    }
    amqp_socket_t* socket = amqp_ssl_socket_new(state);
    if (socket == nullptr) {
        throw AmqpException(ErrorCodes::kCreatingSSLSocket, "Error creating SSL/TLS socket.");
    }
    amqp_ssl_socket_set_verify_peer(socket, 1);
    amqp_ssl_socket_set_verify_hostname(socket, VerifiesHostName(Host) ? 1 : 0);
    const std::string caPath = ResolveCaCertificatePath(CertPath);
    const int status = amqp_ssl_socket_set_cacert(socket, caPath.c_str());
    if (status != AMQP_STATUS_OK) {
        throw AmqpException(
            ErrorCodes::kSettingCACertificate,
            "Error setting CA certificate: " + caPath + ". AMQP status " + std::to_string(status),
            status);
    }
    return socket;
}

int AmqpConnection::OpenSocket(amqp_socket_t* socket) {
    if (ConnectTimeoutMs < 0) {
        return amqp_socket_open_noblock(socket, Host.c_str(), Port, nullptr);
    }
    const int32_t attemptMs = std::min(ConnectTimeoutMs, kLongestAttemptMs);
    const auto deadline = steady_clock::now() + milliseconds(ConnectTimeoutMs);
    // Deliberate hardening: a failure other than a refusal can come at once
    // too (a host name that does not resolve), and is then tried again after
    // a growing pause instead of in a busy loop.
    Backoff backoff;
    for (;;) {
        const auto attemptStarted = steady_clock::now();
        timeval attempt{attemptMs / 1000, (attemptMs % 1000) * 1000};
        const int status = amqp_socket_open_noblock(socket, Host.c_str(), Port, &attempt);
        const auto now = steady_clock::now();
        const auto remaining = std::chrono::duration_cast<milliseconds>(deadline - now);
        if (remaining.count() <= 0 || !IsRetriedOpenStatus(status) || StopRequested) {
            return status;
        }
        // A refused connection fails at once: wait before the next try. The
        // others have taken their attempt's time, unless they came sooner
        // than the back-off.
        const steady_clock::duration pause =
            status == AMQP_STATUS_SOCKET_ERROR
                ? steady_clock::duration(kPauseAfterSocketError)
                : std::max<steady_clock::duration>(
                      steady_clock::duration::zero(),
                      milliseconds(backoff.NextMs()) - (now - attemptStarted));
        if (pause > steady_clock::duration::zero()) {
            PauseBetweenAttempts(std::min<steady_clock::duration>(pause, remaining));
            if (StopRequested) return status;
        }
    }
}

int AmqpConnection::OpenSocketOnce(amqp_socket_t* socket) {
    // A connect time-out of 0 allows the first connect one instant attempt;
    // a reconnect, which has no caller waiting, gets a whole one.
    const int32_t attemptMs = ConnectTimeoutMs <= 0 ? kLongestAttemptMs
                                                    : std::min(ConnectTimeoutMs, kLongestAttemptMs);
    timeval attempt{attemptMs / 1000, (attemptMs % 1000) * 1000};
    return amqp_socket_open_noblock(socket, Host.c_str(), Port, &attempt);
}

void AmqpConnection::PauseBetweenAttempts(steady_clock::duration pause) {
    std::unique_lock<std::mutex> lock(PauseMutex);
    PauseWake.wait_for(lock, pause, [this] { return StopRequested.load(); });
}

void AmqpConnection::RequestStop() {
    {
        std::lock_guard<std::mutex> lock(PauseMutex);
        StopRequested = true;
    }
    PauseWake.notify_all();
}

void AmqpConnection::ThrowOpenFailure(int status) const {
    const std::string statusText = std::to_string(status);
    if (status != AMQP_STATUS_SSL_PEER_VERIFY_FAILED) {
        throw AmqpException(
            ErrorCodes::kOpeningSocket,
            "Error opening TCP socket. RabbitMQ client (rabbitmq-c) status code: " + statusText,
            status);
    }
    // Tell an expired certificate (or a wrong clock) from a broker that the
    // CA did not sign.
    const CaCertificate certificate(ResolveCaCertificatePath(CertPath));
    if (certificate.Get() == nullptr) {
        throw VeldraException(ErrorCodes::kFailedToLoadCertificate,
                              "Auto cert not initialized.");
    }
    if (certificate.IsExpiredAt(std::time(nullptr))) {
        throw AmqpException(ErrorCodes::kCertificateExpired,
                            "Certificate expired or system time incorrect. RabbitMQ client "
                            "(rabbitmq-c) status code: " +
                                statusText,
                            status);
    }
    throw AmqpException(
        ErrorCodes::kPeerVerifyFailed,
        "SSL peer verification failed. RabbitMQ client (rabbitmq-c) status code: " + statusText,
        status);
}

std::shared_ptr<AmqpChannel> AmqpConnection::CreateChannel() {
    ControlGateGuard gate(Gate);
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    const uint16_t id = LowestFreeChannelId(Channels);
    if (id == 0) {
        throw AmqpException(ErrorCodes::kOpeningChannel,
                            "Error opening AMQP channel. No free channel number.");
    }
    OpenChannel(id);
    auto channel = std::make_shared<AmqpChannel>(id, std::make_shared<EnvelopeQueue>());
    Channels.emplace(id, channel);
    if (!ExchangeDeclared) {
        DeclareExchange(id);
        ExchangeDeclared = true;
    }
    return channel;
}

void AmqpConnection::CloseChannel(uint16_t channelId) {
    ControlGateGuard gate(Gate);
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    const auto found = Channels.find(channelId);
    if (found == Channels.end()) return;
    // From here on no notice of a returned message reaches it.
    Channels.erase(found);
    if (ClosedChannels.erase(channelId) != 0) return;  // closed and answered already
    if (Connection == nullptr || ConnectionLost) return;  // the next connection will not open it
    // The number goes back to CreateChannel, and opening a channel that is
    // still open would make the broker close the whole connection. A close
    // is often made on the way out, where nobody keeps the watchdog: the
    // broker gets a few seconds to answer.
    SetRpcTimeout(Connection, std::min(kLongestCloseWait, std::chrono::duration_cast<milliseconds>(
                                                              StallLimit() / 2)));
    SocketWatchdog::Scope watch(Watchdog, Connection);
    const amqp_rpc_reply_t reply = amqp_channel_close(Connection, channelId, AMQP_REPLY_SUCCESS);
    SetRpcTimeout(Connection, std::chrono::duration_cast<milliseconds>(StallLimit() / 2));
    if (reply.reply_type != AMQP_RESPONSE_NORMAL) {
        Log("Error closing AMQP channel " + std::to_string(channelId) + ". " +
            AmqpReplyText(reply));
    }
}

std::shared_ptr<AmqpChannel> AmqpConnection::FindChannel(uint16_t channelId) const {
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    const auto found = Channels.find(channelId);
    return found == Channels.end() ? nullptr : found->second;
}

bool AmqpConnection::IsConnected() const {
    ControlGateGuard gate(Gate);
    return Connection != nullptr;
}

void AmqpConnection::OpenChannel(uint16_t channelId) {
    const std::string context = "Error opening AMQP channel. ";
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kOpeningChannel, context);
    SocketWatchdog::Scope watch(Watchdog, Connection);
    OpenChannelOn(Connection, channelId);
}

void AmqpConnection::OpenChannelOn(amqp_connection_state_t state, uint16_t channelId) {
    amqp_channel_open(state, channelId);
    CheckReply(amqp_get_rpc_reply(state), ErrorCodes::kOpeningChannel,
               "Error opening AMQP channel. ");
}

std::string AmqpConnection::DeclareExchangeContext(uint16_t channelId) const {
    return "Error declaring topic exchange. Channel ID: " + std::to_string(channelId) +
           ". Exchange name: \"" + ExchangeName + "\". ";
}

void AmqpConnection::DeclareExchange(uint16_t channelId) {
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kDeclaringExchange, DeclareExchangeContext(channelId));
    SocketWatchdog::Scope watch(Watchdog, Connection);
    DeclareExchangeOn(Connection, channelId);
}

void AmqpConnection::SendExchangeDeclare(amqp_connection_state_t state, uint16_t channelId) const {
    amqp_exchange_declare(state, channelId, amqp_cstring_bytes(ExchangeName.c_str()),
                          amqp_cstring_bytes("topic"), 0, 1, 0, 0, amqp_empty_table);
}

void AmqpConnection::DeclareExchangeOn(amqp_connection_state_t state, uint16_t channelId) {
    SendExchangeDeclare(state, channelId);
    CheckReply(amqp_get_rpc_reply(state), ErrorCodes::kDeclaringExchange,
               DeclareExchangeContext(channelId));
}

void AmqpConnection::SetQos(uint16_t channelId, uint32_t prefetchSize, uint16_t prefetchCount,
                            bool global) {
    const std::string context =
        "Error changing quality of service. Channel ID: " + std::to_string(channelId) +
        ". Prefetch size: " + std::to_string(prefetchSize) +
        ". Prefetch count: " + std::to_string(prefetchCount) +
        ". Global: " + (global ? "true" : "false") + ". ";
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kSettingQoS, context);
    SocketWatchdog::Scope watch(Watchdog, Connection);
    amqp_basic_qos(Connection, channelId, prefetchSize, prefetchCount, global ? 1 : 0);
    CheckReply(LastReply(), ErrorCodes::kSettingQoS, context);
}

void AmqpConnection::CloseConnection() {
    ControlGateGuard gate(Gate);
    if (Connection == nullptr) return;
    // Called from the destructor too, when no thread keeps the watchdog: the
    // close is polite only while the broker reads and answers promptly.
    amqp_rpc_reply_t reply = AmqpNoReply();
    if (CanSendNow(Connection)) {
        SetRpcTimeout(Connection,
                      std::min(kLongestCloseWait,
                               std::chrono::duration_cast<milliseconds>(StallLimit() / 2)));
        SocketWatchdog::Scope watch(Watchdog, Connection);
        reply = amqp_connection_close(Connection, AMQP_REPLY_SUCCESS);
    }
    // The state goes whatever the broker said, so that nothing is left open.
    const int status = amqp_destroy_connection(Connection);
    Connection = nullptr;
    Socket = nullptr;
    CheckReply(reply, ErrorCodes::kClosingTCPConnection, "Error closing connection. ");
    if (status != AMQP_STATUS_OK) {
        throw AmqpException(ErrorCodes::kEndingTCPConnection,
                            "Error ending connection.  AMQP status: " + std::to_string(status),
                            status);
    }
}

std::chrono::steady_clock::duration AmqpConnection::StallLimit() const {
    const int32_t seconds = HeartbeatSeconds > 0 ? std::max(HeartbeatSeconds, kShortestStallSeconds)
                                                 : kStallSecondsWithoutHeartbeat;
    return std::chrono::seconds(seconds);
}

std::string AmqpConnection::ReplyText(const amqp_rpc_reply_t& reply) {
    return AmqpReplyText(reply);
}

void AmqpConnection::Log(const std::string& line) const {
    if (Manager != nullptr) Manager->Log(line);
}

void AmqpConnection::ReportError(const VeldraException& error) const {
    if (Manager != nullptr) Manager->SetLastError(error);
}

void AmqpConnection::CheckReply(const amqp_rpc_reply_t& reply, int32_t code,
                                const std::string& context) {
    if (reply.reply_type == AMQP_RESPONSE_NORMAL) return;
    throw AmqpException(code, context + AmqpReplyText(reply), reply.library_error);
}

amqp_rpc_reply_t AmqpConnection::LastReply() const {
    return Connection == nullptr ? AmqpNoReply() : amqp_get_rpc_reply(Connection);
}

void AmqpConnection::RequireConnection(int32_t code, const std::string& context) const {
    if (Connection == nullptr) CheckReply(AmqpNoReply(), code, context);
}

}  // namespace Korvane::Veldra::MessageBus
