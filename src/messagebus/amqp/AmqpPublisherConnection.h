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
    // (Veldra.AMQPErrorPublishingMessage) on a non-zero status; no retry.
    void Publish(uint16_t channelId, const MessageHeaders& envelope, const MessageBody& body,
                 bool mandatory);

    void ReaderLoop() override;

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

private:
    void ReaderStep();
    void Poll();
    void SendHeartbeat();

    // ---- State ----
    // Reader thread only.
    bool PollPending = false;
    Clock::time_point LastPoll;
    // Written by publishers and the reader: steady clock ticks.
    std::atomic<Clock::rep> LastSend{0};
};

}  // namespace Korvane::Veldra::MessageBus
