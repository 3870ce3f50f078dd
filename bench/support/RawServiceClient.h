#pragma once

#include <amqp.h>

#include <memory>
#include <string>

#include "messagebus/amqp/AmqpPropertiesC.h"
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
    RawServiceClient(const BrokerAddress& broker, const std::string& exchange);
    ~RawServiceClient();
    RawServiceClient(const RawServiceClient&) = delete;
    RawServiceClient& operator=(const RawServiceClient&) = delete;

    std::unique_ptr<Prepared> Prepare(MessageBus::MessageBase& message) const;

    // Publishes and waits for one reply; throws std::runtime_error when
    // either fails or no reply comes within ten seconds.
    void RoundTrip(const Prepared& message);

private:
    amqp_connection_state_t state_;
    const std::string exchange_;
    const std::string name_;
};

}  // namespace Korvane::Veldra::Bench
