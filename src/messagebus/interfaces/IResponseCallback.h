#pragma once

#include <cstdint>
#include <memory>
#include <string>

#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// Receives a response together with the state its request was sent with.
// Runs on a bus thread.
class IResponseCallback {
public:
    virtual void OnResponse(std::shared_ptr<GenericMessage> message, uint32_t state) = 0;
    // True when OnResponse, for a response of this name, only hands it to a
    // party that waits for it (no user code, no blocking): the connection's
    // reader may then run it itself instead of waking the handling thread.
    virtual bool RunsOnReader(const std::string& messageType) const {
        (void)messageType;
        return false;
    }
    virtual ~IResponseCallback() = default;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
