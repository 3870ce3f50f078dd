#include "messagebus/amqp/AmqpConnectionManager.h"

#include <chrono>
#include <utility>

#include "messagebus/amqp/AmqpConsumerConnection.h"
#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpPublisherConnection.h"
#include "messagebus/config/BusConfigurations.h"

namespace Korvane::Veldra::MessageBus {
namespace {

// The number of a channel handed in by a caller; a null channel is refused,
// before any connection is made for it.
uint16_t IdOf(const std::shared_ptr<AmqpChannel>& channel) {
    if (!channel) throw VeldraException(ErrorCodes::kException, "No AMQP channel given.");
    return channel->Id;
}

}  // namespace

std::recursive_mutex AmqpConnectionManager::ManagerMutex;
AmqpConnectionManager* AmqpConnectionManager::Instance = nullptr;

AmqpConnectionManager::AmqpConnectionManager()
    : AmqpConnectionManager(BusConfigurations::GetSelected().Configuration) {}

AmqpConnectionManager::AmqpConnectionManager(const VeldraConfiguration& configuration)
    : Host(configuration.Host.value_or("")),
      ExchangeName(configuration.ExchangeName.value_or("")),
      User(configuration.User.value_or("")),
      Password(configuration.Password.value_or("")),
      UseTls(configuration.UseTls.value_or(false)),
      TlsServerName(configuration.TlsServerName.value_or("")),
      CertPath(configuration.CertPath.value_or("")),
      Port(configuration.Port.value_or(0)) {}

AmqpConnectionManager::~AmqpConnectionManager() {
    std::shared_ptr<AmqpConsumerConnection> consumer;
    std::shared_ptr<AmqpPublisherConnection> publisher;
    {
        std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
        LastError.reset();
        consumer = std::move(Consumer);
        publisher = std::move(Publisher);
    }
    // The connections' threads are stopped and joined without the class-wide
    // mutex: they take it themselves to report an error or deliver a notice.
    if (consumer) {
        try {
            consumer->Stop();
        } catch (...) {
            // Its destructor stops what is left.
        }
    }
    consumer.reset();
    publisher.reset();
}

AmqpConnectionManager* AmqpConnectionManager::GetInstance() {
    std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
    if (Instance == nullptr) Instance = new AmqpConnectionManager();
    return Instance;
}

void AmqpConnectionManager::ReleaseInstance() {
    AmqpConnectionManager* instance = nullptr;
    {
        std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
        std::swap(instance, Instance);
    }
    // Deleted after the mutex is released; see the destructor.
    delete instance;
}

void AmqpConnectionManager::SetConnectTimeout(int32_t timeoutMs) {
    std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
    ConnectTimeoutMs = timeoutMs;
}

int32_t AmqpConnectionManager::GetConnectTimeout() const {
    std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
    return ConnectTimeoutMs;
}

template <typename Connection>
std::shared_ptr<Connection> AmqpConnectionManager::GetOrMake(std::shared_ptr<Connection>& field) {
    int32_t connectTimeoutMs = 0;
    {
        std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
        if (field) return field;
        connectTimeoutMs = ConnectTimeoutMs;
    }
    // The connect runs without the class-wide mutex: a broker that takes its
    // whole time-out to answer must not hold up the other managers of the
    // process, their reconnect threads included. The other settings are
    // fixed at construction.
    auto made =
        std::make_shared<Connection>(this, User, Password, Host, Port, ExchangeName, UseTls,
                                     TlsServerName, CertPath, connectTimeoutMs, HeartbeatSeconds);
    std::shared_ptr<Connection> kept;
    {
        std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
        if (!field) field = made;
        kept = field;
    }
    // A caller that connected at the same time won: this connection is
    // released here, without the mutex, since its threads take the mutex to
    // report until they are joined.
    made.reset();
    return kept;
}

std::shared_ptr<AmqpPublisherConnection> AmqpConnectionManager::GetPublisherConnection() {
    return GetOrMake(Publisher);
}

std::shared_ptr<AmqpConsumerConnection> AmqpConnectionManager::GetConsumerConnection() {
    return GetOrMake(Consumer);
}

std::shared_ptr<AmqpChannel> AmqpConnectionManager::CreatePublisherChannel() {
    return GetPublisherConnection()->CreateChannel();
}

std::shared_ptr<AmqpChannel> AmqpConnectionManager::CreateConsumerChannel() {
    return GetConsumerConnection()->CreateChannel();
}

void AmqpConnectionManager::Publish(const std::shared_ptr<AmqpChannel>& channel,
                                    const MessageHeaders& envelope, const MessageBody& body,
                                    bool mandatory) {
    const uint16_t id = IdOf(channel);
    GetPublisherConnection()->Publish(id, envelope, body, mandatory);
}

void AmqpConnectionManager::DeclareQueue(const std::shared_ptr<AmqpChannel>& channel,
                                         const std::string& queueName, bool durable, bool exclusive,
                                         bool autoDelete, const std::string& queueType) {
    const uint16_t id = IdOf(channel);
    GetConsumerConnection()->DeclareQueue(id, queueName, durable, exclusive, autoDelete, queueType);
}

void AmqpConnectionManager::SetQos(const std::shared_ptr<AmqpChannel>& channel,
                                   uint32_t prefetchSize, uint16_t prefetchCount, bool global) {
    const uint16_t id = IdOf(channel);
    GetConsumerConnection()->SetQos(id, prefetchSize, prefetchCount, global);
}

void AmqpConnectionManager::AddBinding(const std::shared_ptr<AmqpChannel>& channel,
                                       const std::string& queueName,
                                       const std::vector<std::string>& keys, bool noAck,
                                       bool consume) {
    const uint16_t id = IdOf(channel);
    if (!channel->AddBinding(queueName, keys)) return;
    const auto connection = GetConsumerConnection();
    if (consume) {
        channel->AddConsumerTag(connection->BindAndConsume(id, queueName, keys, noAck));
    } else {
        connection->BindQueue(id, queueName, keys);
    }
}

void AmqpConnectionManager::RemoveBinding(const std::shared_ptr<AmqpChannel>& channel,
                                          const std::string& queueName,
                                          const std::vector<std::string>& keys) {
    const uint16_t id = IdOf(channel);
    if (channel->RemoveBinding(queueName, keys)) {
        GetConsumerConnection()->Unbind(id, queueName, keys);
    }
}

void AmqpConnectionManager::RebindAll(const std::shared_ptr<AmqpChannel>& channel, bool noAck,
                                      bool consume) {
    const uint16_t id = IdOf(channel);
    const auto consumer = GetConsumerConnection();
    channel->TakeConsumerTags();
    for (const AmqpBinding& binding : channel->GetBindings()) {
        if (consume) {
            channel->AddConsumerTag(
                consumer->BindAndConsume(id, binding.QueueName, binding.Keys, noAck));
        } else {
            consumer->BindQueue(id, binding.QueueName, binding.Keys);
        }
    }
}

void AmqpConnectionManager::ConsumeAll(const std::shared_ptr<AmqpChannel>& channel, bool noAck) {
    const uint16_t id = IdOf(channel);
    const auto consumer = GetConsumerConnection();
    for (const AmqpBinding& binding : channel->GetBindings()) {
        channel->AddConsumerTag(consumer->Consume(id, binding.QueueName, noAck));
    }
}

void AmqpConnectionManager::CancelAll(const std::shared_ptr<AmqpChannel>& channel) {
    const uint16_t id = IdOf(channel);
    const auto consumer = GetConsumerConnection();
    for (const std::string& tag : channel->TakeConsumerTags()) consumer->Cancel(id, tag);
}

void AmqpConnectionManager::Ack(const std::shared_ptr<AmqpChannel>& channel, uint64_t deliveryTag) {
    const uint16_t id = IdOf(channel);
    GetConsumerConnection()->Ack(id, deliveryTag);
}

void AmqpConnectionManager::Requeue(const std::shared_ptr<AmqpChannel>& channel,
                                    uint64_t deliveryTag) {
    const uint16_t id = IdOf(channel);
    GetConsumerConnection()->Requeue(id, deliveryTag);
}

void AmqpConnectionManager::Start() {
    GetConsumerConnection()->Start();
}

void AmqpConnectionManager::Stop() {
    GetConsumerConnection()->Stop();
}

template <typename Connection>
std::shared_ptr<Connection> AmqpConnectionManager::Existing(
    const std::shared_ptr<Connection>& field) const {
    std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
    return field;
}

void AmqpConnectionManager::DeliverReturnEvent(const ResetEvent& event) {
    // Called from the publisher's reader: never makes a connection, and with
    // no consumer connection nobody waits for the notice.
    if (const auto consumer = Existing(Consumer)) consumer->DeliverReturnEvent(event);
}

void AmqpConnectionManager::ResetConsumerChannels() {
    if (const auto consumer = Existing(Consumer)) consumer->ResetChannels();
}

void AmqpConnectionManager::CloseConsumerChannel(const std::shared_ptr<AmqpChannel>& channel) {
    const uint16_t id = IdOf(channel);
    if (const auto consumer = Existing(Consumer)) consumer->CloseChannel(id);
}

void AmqpConnectionManager::ConsumerConnectionLost() {
    if (const auto publisher = Existing(Publisher)) publisher->PollSoon();
}

bool AmqpConnectionManager::AwaitPublisher(uint32_t timeoutMs) {
    const auto publisher = Existing(Publisher);
    return publisher && publisher->WaitUntilConnected(std::chrono::milliseconds(timeoutMs));
}

bool AmqpConnectionManager::IsPublisherLost() {
    const auto publisher = Existing(Publisher);
    return !publisher || publisher->IsLost();
}

void AmqpConnectionManager::Log(const std::string& line) {
    StatusLines.AddEvictingOldest(line);
}

bool AmqpConnectionManager::TakeLog(std::string& line, uint32_t timeoutMs) {
    return StatusLines.TryTake(line, timeoutMs);
}

void AmqpConnectionManager::SetLastError(const VeldraException& error) {
    std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
    LastError = std::make_unique<VeldraException>(error.Code(), error.what());
}

bool AmqpConnectionManager::GetLastError(VeldraException& error) const {
    std::lock_guard<std::recursive_mutex> lock(ManagerMutex);
    if (!LastError) return false;
    error = VeldraException(LastError->Code(), LastError->what());
    return true;
}

}  // namespace Korvane::Veldra::MessageBus
