#pragma once

#include <sys/time.h>

#include <atomic>
#include <chrono>
#include <cstdint>
#include <string>

#include "messagebus/amqp/AmqpPollingConnection.h"
#include "messagelibrary/MessageBody.h"
#include "messagelibrary/MessageHeaders.h"

namespace Korvane::Veldra::MessageBus {

// The connection on which every outgoing message leaves. Publishing runs on
// the caller's thread under the gate; there is no outgoing queue. A reader
// thread polls for what the broker sends back (returned messages, closes) at
// most once a second while idle and keeps heartbeats going; a reconnect
// thread connects anew when the reader reports a failure.
class AmqpPublisherConnection : public AmqpPollingConnection {
public:
    // Connects, then starts the two threads.
    AmqpPublisherConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                            std::string host, int32_t port, std::string exchangeName, bool useTls,
                            std::string tlsServerName, std::string certPath,
                            int32_t connectTimeoutMs, int32_t heartbeatSeconds);
    // Stops the threads, then closes the connection.
    ~AmqpPublisherConnection() override;

    // Starts the reader and the reconnect thread unless they run.
    void Start();
    // Ends both threads and waits for them. A socket call that holds the gate
    // meanwhile is cut short, so this returns soon even then.
    void Stop();

    // Publishes the body on the channel to ExchangeName with the envelope's
    // routing key and properties. Throws AmqpException
    // (Veldra.AMQPErrorPublishingMessage) on a non-zero status, and at once,
    // without waiting for the gate, while the connection is lost; no retry.
    // A channel that the broker closed is opened again, and the exchange
    // declared again, before the message goes.
    void Publish(uint16_t channelId, const MessageHeaders& envelope, const MessageBody& body,
                 bool mandatory);

    void ReaderLoop() override;

    // Asks the reader to poll at once rather than at its next idle poll: the
    // other connection to the same broker was just found lost, and this one
    // most likely is too.
    void PollSoon();

protected:
    // As the public constructor, with the TLS start-up library given.
    AmqpPublisherConnection(AmqpConnectionManager* manager, std::string user, std::string password,
                            std::string host, int32_t port, std::string exchangeName, bool useTls,
                            std::string tlsServerName, std::string certPath,
                            int32_t connectTimeoutMs, int32_t heartbeatSeconds,
                            SslInitLibrary& sslLibrary);

    // Hands the notice to the manager, which gives it to every channel of the
    // consumer connection.
    void DeliverReturnedMessage(const ResetEvent& event) override;
    // Answers and marks the channel closed; the next publish opens it again.
    void OnChannelClosed(amqp_channel_t channel) override;

private:
    // Opens the channel again when the broker closed it, and declares the
    // exchange: the usual reason for the close is that the exchange is gone.
    // True when it did. Call with the gate held.
    bool RestoreClosedChannel(uint16_t channelId);
    void ReaderStep();
    void Poll();
    void SendHeartbeat();

    // ---- State ----
    // Reader thread only.
    bool PollPending = false;
    Clock::time_point LastPoll;
    // Written by publishers and the reader: steady clock ticks.
    std::atomic<Clock::rep> LastSend{0};
    std::atomic<bool> PollRequested{false};
};

}  // namespace Korvane::Veldra::MessageBus
