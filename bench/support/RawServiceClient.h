#pragma once

#include <amqp.h>

#include <atomic>
#include <memory>
#include <string>
#include <thread>

#include "messagebus/amqp/AmqpPropertiesC.h"
#include "messagebus/concurrency/Semaphore.h"
#include "messagelibrary/MessageBase.h"
#include "support/BenchBroker.h"

namespace Korvane::Veldra::Bench {

// The baseline of the benchmarks against the reference tag service:
// rabbitmq-c alone, one connection with a reply queue of its own, publishing
// the body and properties that the library would send and waiting for the
// service's reply. One request in flight at a time; one thread a client.
class RawServiceClient {
public:
    // A message as the library would send it, answered to this client, in
    // the form amqp_basic_publish takes. Not movable: the rabbitmq-c
    // properties point into the record.
    struct Prepared {
        explicit Prepared(MessageBus::MessageBase& message, const std::string& replyTo);
        Prepared(const Prepared&) = delete;
        Prepared& operator=(const Prepared&) = delete;

        std::string routingKey;
        std::string body;
        MessageBus::AmqpProperties record;
        MessageBus::AmqpBasicProperties properties;
    };

    // Connects and binds a reply queue of a new name to "Veldra.<name>.#" on
    // the exchange, so that the service's answers to ReplyTo <name> arrive on
    // it; throws std::runtime_error when the broker refuses.
    //
    // With handOff the client takes the library's shape: requests go out on
    // a second connection, and a thread of its own reads the replies and
    // hands each to the waiting caller. The difference from the plain client
    // is what that shape costs a round trip, with no library code in it.
    RawServiceClient(const BrokerAddress& broker, const std::string& exchange,
                     bool handOff = false);
    ~RawServiceClient();
    RawServiceClient(const RawServiceClient&) = delete;
    RawServiceClient& operator=(const RawServiceClient&) = delete;

    std::unique_ptr<Prepared> Prepare(MessageBus::MessageBase& message) const;

    // Publishes and waits for one reply; throws std::runtime_error when
    // either fails or no reply comes within ten seconds.
    void RoundTrip(const Prepared& message);

private:
    void ReadReplies();

    amqp_connection_state_t state_;                // consumes the replies
    amqp_connection_state_t publisher_ = nullptr;  // with handOff only
    const std::string exchange_;
    const std::string name_;
    MessageBus::Semaphore replies_;
    std::atomic<bool> stop_{false};
    std::thread reader_;
};

}  // namespace Korvane::Veldra::Bench
