#pragma once

#include <chrono>
#include <cstdint>
#include <memory>
#include <string>

#include "messagebus/concurrency/SharedQueue.h"
#include "messagebus/concurrency/ThreadSafeMap.h"
#include "messagebus/interfaces/IBroadcastCallback.h"
#include "messagebus/interfaces/IResponseCallback.h"
#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::MessageBus {

// Where a synchronous caller waits for its response.
using ResponseWaiter = SharedQueue<std::shared_ptr<GenericMessage>>;

// A synchronous caller waiting for the response with its correlation id.
struct SynchCallbackInfo {
    std::shared_ptr<ResponseWaiter> Waiter;
};

// A one-shot callback for the response with its correlation id.
struct CorrIdCallbackInfo {
    std::shared_ptr<Interfaces::IResponseCallback> Callback;
    uint32_t State = 0;
    // Steady clock, nanoseconds: when the callback was registered.
    int64_t CreatedAt = 0;
    // Steady clock, nanoseconds: when its request times out and the entry
    // goes; 0 when only the purge by age removes it.
    int64_t ExpiresAt = 0;
};

// The handler of every message with its name; the entry stays until removed.
struct MessageNameCallbackInfo {
    std::shared_ptr<Interfaces::IBroadcastCallback> Callback;
    // True when the callback acknowledges by itself.
    bool ManualAck = false;
};

using SynchCallbackMap = ThreadSafeMap<std::string, SynchCallbackInfo>;
using CorrIdCallbackMap = ThreadSafeMap<std::string, CorrIdCallbackInfo>;
using NameCallbackMap = ThreadSafeMap<std::string, MessageNameCallbackInfo>;

// The steady clock in nanoseconds, the time base of the callback maps.
inline int64_t SteadyNowNs() {
    return std::chrono::duration_cast<std::chrono::nanoseconds>(
               std::chrono::steady_clock::now().time_since_epoch())
        .count();
}

}  // namespace Korvane::Veldra::MessageBus
