#pragma once

#include <cstdint>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

#include "errors/VeldraException.h"
#include "messagebus/amqp/AmqpChannel.h"
#include "messagebus/concurrency/ResetEvent.h"
#include "messagebus/concurrency/SharedQueue.h"
#include "messagebus/config/VeldraConfiguration.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {

class AmqpPublisherConnection;
class AmqpConsumerConnection;

// The settings of one broker configuration and the two connections made from
// them on first use, one outgoing and one incoming. It is the one door through
// which publishers and consumers reach the broker, and it keeps the bus's
// status lines and its last asynchronous error. There is a process singleton,
// and any number of private instances.
class AmqpConnectionManager {
public:
    static constexpr int32_t kHeartbeatSeconds = 270;
    static constexpr int32_t kDefaultConnectTimeoutMs = 180000;
    // Status lines kept for TakeLog: the newest ones.
    static constexpr int32_t kStatusLineLimit = 1000;

    // Settings from the selected configuration of the process.
    AmqpConnectionManager();
    // Settings from the given record; absent fields are empty, 0 or false.
    explicit AmqpConnectionManager(const VeldraConfiguration& configuration);
    // Stops the consumer connection, then releases both connections; their
    // threads end in their destructors.
    ~AmqpConnectionManager();
    AmqpConnectionManager(const AmqpConnectionManager&) = delete;
    AmqpConnectionManager& operator=(const AmqpConnectionManager&) = delete;

    // ---- The process singleton ----
    static AmqpConnectionManager* GetInstance();
    // Deletes the singleton, if any.
    static void ReleaseInstance();

    // For connections made after the call.
    void SetConnectTimeout(int32_t timeoutMs);

    // The connection, made (and connected) on first use, outside the
    // class-wide mutex; when two callers make it at once, the first one kept
    // is handed to both and the other is closed. A failed construction leaves
    // none, so the next use tries again.
    std::shared_ptr<AmqpPublisherConnection> GetPublisherConnection();
    std::shared_ptr<AmqpConsumerConnection> GetConsumerConnection();
    std::shared_ptr<AmqpChannel> CreatePublisherChannel();
    std::shared_ptr<AmqpChannel> CreateConsumerChannel();

    void Publish(const std::shared_ptr<AmqpChannel>& channel, const MessageHeaders& envelope,
                 const MessageBody& body, bool mandatory);
    // A non-empty queueType goes with the declaration as x-queue-type.
    void DeclareQueue(const std::shared_ptr<AmqpChannel>& channel, const std::string& queueName,
                      bool durable, bool exclusive, bool autoDelete,
                      const std::string& queueType = std::string());
    void SetQos(const std::shared_ptr<AmqpChannel>& channel, uint32_t prefetchSize,
                uint16_t prefetchCount, bool global);
    // Binds, and with `consume` starts a consumer on the queue, only when the
    // channel did not record this binding.
    void AddBinding(const std::shared_ptr<AmqpChannel>& channel, const std::string& queueName,
                    const std::vector<std::string>& keys, bool noAck, bool consume = true);
    // Unbinds only when the channel had recorded this binding.
    void RemoveBinding(const std::shared_ptr<AmqpChannel>& channel, const std::string& queueName,
                       const std::vector<std::string>& keys);
    // Binds every recorded binding of the channel again, and with `consume`
    // starts a consumer for each; the consumers of before are gone.
    void RebindAll(const std::shared_ptr<AmqpChannel>& channel, bool noAck, bool consume = true);
    // Starts a consumer on the queue of each recorded binding, as binding
    // while consuming would have: the broker delivers from here on.
    void ConsumeAll(const std::shared_ptr<AmqpChannel>& channel, bool noAck);
    // Cancels every consumer of the channel: what arrives from here on stays
    // in the broker's queue.
    void CancelAll(const std::shared_ptr<AmqpChannel>& channel);
    void Ack(const std::shared_ptr<AmqpChannel>& channel, uint64_t deliveryTag);
    void Requeue(const std::shared_ptr<AmqpChannel>& channel, uint64_t deliveryTag);
    // Start and Stop of the consumer connection.
    void Start();
    void Stop();
    // Gives the notice to every channel of the consumer connection.
    void DeliverReturnEvent(const ResetEvent& event);
    // Posts the reset of every channel of the consumer connection, if there
    // is one, so that each consumer declares its queue and binds again.
    void ResetConsumerChannels();
    // Closes the channel on the consumer connection, if there is one.
    void CloseConsumerChannel(const std::shared_ptr<AmqpChannel>& channel);
    // True while the publisher connection is lost, or was never made.
    bool IsPublisherLost();
    // Waits up to timeoutMs while the publisher connection is lost; true when
    // it is connected.
    bool AwaitPublisher(uint32_t timeoutMs);
    // The consumer connection was found lost: the publisher's reader looks at
    // its own connection at once instead of within the second.
    void ConsumerConnectionLost();

    // ---- Status lines and the last asynchronous error ----
    // Appends a status line; past kStatusLineLimit the oldest one goes.
    void Log(const std::string& line);
    // The status lines kept at the moment.
    std::size_t StatusLineCount() const { return StatusLines.Size(); }
    bool TakeLog(std::string& line, uint32_t timeoutMs);
    // Keeps a copy of text and code; an AmqpException's status is not kept.
    void SetLastError(const VeldraException& error);
    // Copies the stored error into error; false when there is none.
    bool GetLastError(VeldraException& error) const;

    // ---- Settings ----
    const std::string& GetHost() const { return Host; }
    const std::string& GetExchangeName() const { return ExchangeName; }
    const std::string& GetUser() const { return User; }
    bool GetUseTls() const { return UseTls; }
    const std::string& GetTlsServerName() const { return TlsServerName; }
    const std::string& GetCertPath() const { return CertPath; }
    int32_t GetPort() const { return Port; }
    int32_t GetHeartbeatSeconds() const { return HeartbeatSeconds; }
    int32_t GetConnectTimeout() const;

private:
    // Shared by all instances; recursive so that a constructor chain may
    // reach GetInstance.
    static std::recursive_mutex ManagerMutex;
    static AmqpConnectionManager* Instance;

    template <typename Connection>
    std::shared_ptr<Connection> GetOrMake(std::shared_ptr<Connection>& field);
    // The connection if it has been made; never makes one.
    template <typename Connection>
    std::shared_ptr<Connection> Existing(const std::shared_ptr<Connection>& field) const;

    std::string Host;
    std::string ExchangeName;
    std::string User;
    std::string Password;
    bool UseTls = false;
    std::string TlsServerName;
    std::string CertPath;
    int32_t Port = 0;
    int32_t HeartbeatSeconds = kHeartbeatSeconds;
    int32_t ConnectTimeoutMs = kDefaultConnectTimeoutMs;
    // Declared before the connections: their threads log until they end.
    // Deliberate hardening: bounded, as a reconnect loop that retries for
    // days logs each attempt, and nothing in the library drains them.
    SharedQueue<std::string> StatusLines{kStatusLineLimit};
    std::unique_ptr<VeldraException> LastError;
    std::shared_ptr<AmqpPublisherConnection> Publisher;
    std::shared_ptr<AmqpConsumerConnection> Consumer;
};

}  // namespace Korvane::Veldra::MessageBus
