#pragma once

#include <cstdint>
#include <memory>

#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// Receives a response together with the state its request was sent with.
// Runs on a bus thread.
class IResponseCallback {
public:
    virtual void OnResponse(std::shared_ptr<GenericMessage> message, uint32_t state) = 0;
    virtual ~IResponseCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
