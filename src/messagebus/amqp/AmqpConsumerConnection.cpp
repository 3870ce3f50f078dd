#include "messagebus/amqp/AmqpConsumerConnection.h"

#include <chrono>
#include <thread>
#include <utility>

#include "errors/ErrorCodes.h"
#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/amqp/AmqpFrames.h"

namespace Korvane::Veldra::MessageBus {
namespace {

const AmqpPollingConnection::Texts kTexts{"Attempting to reconnect to AMQP...",
                                          "AMQP connection was unexpectedly closed.",
                                          "connection manager"};

// The reader holds the gate for at most this long at a time.
constexpr timeval kPollTimeout{0, 100000};
constexpr auto kNoConnectionPause = std::chrono::milliseconds(10);

std::string ChannelText(uint16_t channelId) {
    return std::to_string(channelId);
}

const char* Flag(bool value) {
    return value ? "1" : "0";
}

}  // namespace

std::string BindingKey(const std::vector<std::string>& keys) {
    std::string key = "Veldra";
    for (const std::string& element : keys) {
        key += '.';
        key += element;
    }
    return key;
}

AmqpConsumerConnection::AmqpConsumerConnection(AmqpConnectionManager* manager, std::string user,
                                               std::string password, std::string host, int32_t port,
                                               std::string exchangeName, bool useTls,
                                               std::string tlsServerName, std::string certPath,
                                               int32_t connectTimeoutMs, int32_t heartbeatSeconds)
    : AmqpConsumerConnection(manager, std::move(user), std::move(password), std::move(host), port,
                             std::move(exchangeName), useTls, std::move(tlsServerName),
                             std::move(certPath), connectTimeoutMs, heartbeatSeconds,
                             SslInitLibrary::Process()) {}

AmqpConsumerConnection::AmqpConsumerConnection(AmqpConnectionManager* manager, std::string user,
                                               std::string password, std::string host, int32_t port,
                                               std::string exchangeName, bool useTls,
                                               std::string tlsServerName, std::string certPath,
                                               int32_t connectTimeoutMs, int32_t heartbeatSeconds,
                                               SslInitLibrary& sslLibrary)
    : AmqpPollingConnection(manager, std::move(user), std::move(password), std::move(host), port,
                            std::move(exchangeName), useTls, std::move(tlsServerName),
                            std::move(certPath), connectTimeoutMs, heartbeatSeconds, sslLibrary,
                            kTexts) {}

AmqpConsumerConnection::~AmqpConsumerConnection() {
    try {
        Stop();
    } catch (...) {
        // The base closes the connection all the same.
    }
}

std::shared_ptr<AmqpChannel> AmqpConsumerConnection::CreateChannel() {
    ControlGateGuard gate(Gate);
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    SocketWatchdog::Scope watch(Watchdog, Connection);
    return AmqpPollingConnection::CreateChannel();
}

void AmqpConsumerConnection::CloseChannel(uint16_t channelId) {
    ControlGateGuard gate(Gate);
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    AmqpPollingConnection::CloseChannel(channelId);
}

void AmqpConsumerConnection::Start() {
    std::lock_guard<std::mutex> lock(StartMutex);
    ++StartCount;
    if (!ReconnectThread && StartCount == 1) StartThreads();
}

void AmqpConsumerConnection::Stop() {
    std::lock_guard<std::mutex> lock(StartMutex);
    if (StartCount > 0) --StartCount;
    if (ReconnectThread && StartCount == 0) StopThreads();
}

int32_t AmqpConsumerConnection::GetStartCount() {
    std::lock_guard<std::mutex> lock(StartMutex);
    return StartCount;
}

void AmqpConsumerConnection::DeclareQueue(uint16_t channelId, const std::string& queueName,
                                          bool durable, bool exclusive, bool autoDelete,
                                          const std::string& queueType) {
    const std::string context = "Error declaring queue. Channel ID: " + ChannelText(channelId) +
                                ". Queue name: \"" + queueName + "\". Durable: " + Flag(durable) +
                                ". Exclusive: " + Flag(exclusive) +
                                ". Auto Delete: " + Flag(autoDelete) +
                                (queueType.empty() ? "" : ". Queue type: " + queueType) + ". ";
    amqp_table_entry_t typeEntry;
    typeEntry.key = amqp_cstring_bytes("x-queue-type");
    typeEntry.value.kind = AMQP_FIELD_KIND_UTF8;
    typeEntry.value.value.bytes = TextBytes(queueType);
    const amqp_table_t arguments =
        queueType.empty() ? amqp_empty_table : amqp_table_t{1, &typeEntry};
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kDeclaringQueue, context);
    ReopenIfClosed(channelId);
    amqp_queue_declare_ok_t* declared = nullptr;
    {
        SocketWatchdog::Scope watch(Watchdog, Connection);
        declared =
            amqp_queue_declare(Connection, channelId, TextBytes(queueName), 0, durable ? 1 : 0,
                               exclusive ? 1 : 0, autoDelete ? 1 : 0, arguments);
    }
    CheckChannelReply(channelId, ErrorCodes::kDeclaringQueue, context);
    if (declared == nullptr || declared->queue.len == 0) {
        throw AmqpException(ErrorCodes::kObtainingQueueName, "Error obtaining queue name.");
    }
}

std::string AmqpConsumerConnection::BindAndConsume(uint16_t channelId,
                                                   const std::string& queueName,
                                                   const std::vector<std::string>& keys,
                                                   bool noAck) {
    ControlGateGuard gate(Gate);
    BindQueue(channelId, queueName, keys);
    return Consume(channelId, queueName, noAck);
}

void AmqpConsumerConnection::BindQueue(uint16_t channelId, const std::string& queueName,
                                       const std::vector<std::string>& keys) {
    const std::string key = BindingKey(keys);
    const std::string context = "Error binding queue. Channel ID: " + ChannelText(channelId) +
                                ". Queue name: \"" + queueName + "\". Exchange name: \"" +
                                ExchangeName + "\". Binding key: \"" + key + "\". ";
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kBindingQueue, context);
    ReopenIfClosed(channelId);
    {
        SocketWatchdog::Scope watch(Watchdog, Connection);
        amqp_queue_bind(Connection, channelId, TextBytes(queueName),
                        amqp_cstring_bytes(ExchangeName.c_str()), TextBytes(key), amqp_empty_table);
    }
    CheckChannelReply(channelId, ErrorCodes::kBindingQueue, context);
}

std::string AmqpConsumerConnection::Consume(uint16_t channelId, const std::string& queueName,
                                            bool noAck) {
    const std::string context = "Error performing basic consume. Channel ID: " +
                                ChannelText(channelId) + ". Queue name: \"" + queueName + "\". ";
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kPerformingBasicConsume, context);
    ReopenIfClosed(channelId);
    amqp_basic_consume_ok_t* consumed = nullptr;
    {
        // The broker names the consumer.
        SocketWatchdog::Scope watch(Watchdog, Connection);
        consumed = amqp_basic_consume(Connection, channelId, TextBytes(queueName),
                                      amqp_empty_bytes, 0, noAck ? 1 : 0, 0, amqp_empty_table);
    }
    CheckChannelReply(channelId, ErrorCodes::kPerformingBasicConsume, context);
    return consumed == nullptr ? std::string() : BytesText(consumed->consumer_tag);
}

void AmqpConsumerConnection::Cancel(uint16_t channelId, const std::string& consumerTag) {
    ControlGateGuard gate(Gate);
    if (Connection == nullptr || ConnectionLost || IsClosed(channelId) || consumerTag.empty()) {
        return;
    }
    {
        SocketWatchdog::Scope watch(Watchdog, Connection);
        amqp_basic_cancel(Connection, channelId, TextBytes(consumerTag));
    }
    CheckChannelReply(channelId, ErrorCodes::kPerformingBasicConsume,
                      "Error cancelling a consumer. Channel ID: " + ChannelText(channelId) +
                          ". Consumer tag: \"" + consumerTag + "\". ");
}

void AmqpConsumerConnection::Unbind(uint16_t channelId, const std::string& queueName,
                                    const std::vector<std::string>& keys) {
    const std::string key = BindingKey(keys);
    const std::string context = "Error unbinding queue. Channel ID: " + ChannelText(channelId) +
                                ". Queue name: \"" + queueName + "\". Exchange name: \"" +
                                ExchangeName + "\". Binding key: \"" + key + "\". ";
    ControlGateGuard gate(Gate);
    RequireConnection(ErrorCodes::kUnbindingQueue, context);
    ReopenIfClosed(channelId);
    {
        SocketWatchdog::Scope watch(Watchdog, Connection);
        amqp_queue_unbind(Connection, channelId, TextBytes(queueName),
                          amqp_cstring_bytes(ExchangeName.c_str()), TextBytes(key),
                          amqp_empty_table);
    }
    CheckChannelReply(channelId, ErrorCodes::kUnbindingQueue, context);
}

void AmqpConsumerConnection::Ack(uint16_t channelId, uint64_t deliveryTag) {
    if (deliveryTag == 0) return;
    ControlGateGuard gate(Gate);
    if (Connection == nullptr || IsClosed(channelId)) return;
    SocketWatchdog::Scope watch(Watchdog, Connection);
    amqp_basic_ack(Connection, channelId, deliveryTag, 0);
}

void AmqpConsumerConnection::Requeue(uint16_t channelId, uint64_t deliveryTag) {
    if (deliveryTag == 0) return;
    ControlGateGuard gate(Gate);
    if (Connection == nullptr || IsClosed(channelId)) return;
    SocketWatchdog::Scope watch(Watchdog, Connection);
    amqp_basic_nack(Connection, channelId, deliveryTag, 0, 1);
}

void AmqpConsumerConnection::DeliverReturnEvent(const ResetEvent& event) {
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    for (const auto& entry : Channels) entry.second->ReturnEvents->Add(event);
}

void AmqpConsumerConnection::DeliverReturnedMessage(const ResetEvent& event) {
    DeliverReturnEvent(event);
}

void AmqpConsumerConnection::ResetChannels() {
    std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
    for (const auto& entry : Channels) entry.second->RequestReset();
}

void AmqpConsumerConnection::OnReconnected() {
    ResetChannels();
}

void AmqpConsumerConnection::OnConnectionLost() {
    {
        std::lock_guard<std::recursive_mutex> lock(ChannelMutex);
        for (const auto& entry : Channels) entry.second->MarkUnbound();
    }
    if (Manager != nullptr) Manager->ConsumerConnectionLost();
}

void AmqpConsumerConnection::ReaderLoop() {
    try {
        while (!Disconnected) ReaderStep();
        return;
    } catch (const std::exception& error) {
        try {
            const std::string line = std::string("Consumer reader stopped: ") + error.what();
            Log(line);
            ReportError(VeldraException(ErrorCodes::kException, line));
        } catch (...) {
            // Out of memory: the reconnect below matters more than the report.
        }
    }
    // Without a reader nothing arrives: start again as after a lost connection.
    Disconnect();
}

void AmqpConsumerConnection::ReaderStep() {
    // A poll holds the gate for at most 100 milliseconds.
    if (PollOnce(kPollTimeout) == PollOutcome::NotConnected) {
        std::this_thread::sleep_for(kNoConnectionPause);
    }
}

}  // namespace Korvane::Veldra::MessageBus
