#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <unordered_map>
#include <vector>

#include "messagebus/amqp/AmqpPollingConnection.h"
#include "messagebus/concurrency/ResetEvent.h"

namespace Korvane::Veldra::MessageBus {

// The routing key of a binding: "Veldra", then "." and each key in order.
std::string BindingKey(const std::vector<std::string>& keys);

// The connection on which everything arrives. Its reader thread takes the
// deliveries with a 100 millisecond poll and sorts them into the envelope
// queues of their channels; it never runs user code. The threads run only
// while some consumer wants messages: between the first Start and the Stop
// that matches the last one.
class AmqpConsumerConnection : public AmqpPollingConnection {
public:
    AmqpConsumerConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                           std::string host, int32_t port, std::string exchangeName, bool useTls,
                           std::string tlsServerName, std::string certPath,
                           int32_t connectTimeoutMs, int32_t heartbeatSeconds);
    // Stops once, then closes the connection. Every consumer must be gone
    // first: with more than one Start outstanding the threads would remain.
    ~AmqpConsumerConnection() override;

    std::shared_ptr<AmqpChannel> CreateChannel() override;
    void CloseChannel(uint16_t channelId) override;

    // Counts the start; the first one starts the reader and the reconnect
    // thread.
    void Start();
    // Counts the stop, never below zero; at zero the threads end.
    void Stop();

    // amqp_queue_declare, not passive, with no arguments but x-queue-type
    // when queueType is not empty. Throws AmqpException
    // (Veldra.AMQPErrorDeclaringQueue), or Veldra.AMQPErrorObtainingQueueName
    // when the broker answers with an empty name.
    void DeclareQueue(uint16_t channelId, const std::string& queueName, bool durable,
                      bool exclusive, bool autoDelete,
                      const std::string& queueType = std::string());
    // Binds the queue to the exchange with BindingKey(keys), then starts a
    // further basic.consume on it; returns the broker's consumer tag.
    std::string BindAndConsume(uint16_t channelId, const std::string& queueName,
                               const std::vector<std::string>& keys, bool noAck);
    // The two halves of BindAndConsume.
    void BindQueue(uint16_t channelId, const std::string& queueName,
                   const std::vector<std::string>& keys);
    std::string Consume(uint16_t channelId, const std::string& queueName, bool noAck);
    // Ends the broker's deliveries to one consumer (basic.cancel); what the
    // queue holds stays there. Nothing on a lost connection or a closed
    // channel, whose consumers are gone already.
    void Cancel(uint16_t channelId, const std::string& consumerTag);
    void Unbind(uint16_t channelId, const std::string& queueName,
                const std::vector<std::string>& keys);
    // A delivery tag of 0 does nothing, and so does a channel the broker
    // closed: its delivery tags went with it.
    void Ack(uint16_t channelId, uint64_t deliveryTag);
    // Gives the message back to the queue; does nothing where Ack does.
    void Requeue(uint16_t channelId, uint64_t deliveryTag);
    // A copy of the notice to the return queue of every channel.
    void DeliverReturnEvent(const ResetEvent& event);
    // Posts the reset of every channel: each consumer declares and binds anew.
    void ResetChannels();

    // Polls until the connection is lost or stopped. A poll that throws ends
    // the loop like a lost connection: the error goes to the manager's last
    // error and a reconnect starts.
    void ReaderLoop() override;

    // Start calls not yet matched by Stop.
    int32_t GetStartCount();

protected:
    AmqpConsumerConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                           std::string host, int32_t port, std::string exchangeName, bool useTls,
                           std::string tlsServerName, std::string certPath,
                           int32_t connectTimeoutMs, int32_t heartbeatSeconds,
                           SslInitLibrary& sslLibrary);

    // Posts the reset of every channel, so that the consumers declare and
    // bind again on the new connection.
    void OnReconnected() override;
    // Every channel's queue may be gone with the connection.
    void OnConnectionLost() override;
    void DeliverReturnedMessage(const ResetEvent& event) override;

    // One poll of the reader loop; virtual so that a test can make it fail.
    virtual void ReaderStep();

private:
    // ---- State ----
    int32_t StartCount = 0;
};

}  // namespace Korvane::Veldra::MessageBus
