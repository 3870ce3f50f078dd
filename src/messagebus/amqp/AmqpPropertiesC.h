#pragma once

#include <amqp.h>

#include <vector>

#include "messagelibrary/AmqpProperties.h"

namespace Korvane::Veldra::MessageBus {

// rabbitmq-c's form of an AmqpProperties record, for amqp_basic_publish. It
// points into the record it was made from, which must outlive it and stay
// unchanged; the header table is built in one array.
class AmqpBasicProperties {
public:
    explicit AmqpBasicProperties(const AmqpProperties& properties);
    AmqpBasicProperties(const AmqpBasicProperties&) = delete;
    AmqpBasicProperties& operator=(const AmqpBasicProperties&) = delete;

    const amqp_basic_properties_t* Get() const { return &properties_; }

private:
    std::vector<amqp_table_entry_t> entries_;
    amqp_basic_properties_t properties_;
};

// The record of received properties; only the fields AmqpProperties has are
// read, each only when its flag is set. Header values of the string kinds are
// copied as bytes; numbers and booleans arrive in their decimal or
// "true"/"false" text, and other kinds as an empty text.
AmqpProperties FromAmqpBasicProperties(const amqp_basic_properties_t& properties);

}  // namespace Korvane::Veldra::MessageBus
