#pragma once

#include <cstdint>
#include <string>

#include "errors/VeldraException.h"

namespace Korvane::Veldra::MessageBus {

// A failure of an AMQP step: a code of one of the AMQPError rows, a text that
// names the step and its context, and the status of the failed rabbitmq-c
// reply (0 when there is none). Handlers of VeldraException catch it too.
class AmqpException : public VeldraException {
public:
    AmqpException(int32_t code, const std::string& message, int32_t status = 0)
        : VeldraException(code, message), status_(status) {}
    ~AmqpException() override = default;

    int32_t Status() const noexcept { return status_; }

private:
    int32_t status_;
};

}  // namespace Korvane::Veldra::MessageBus
