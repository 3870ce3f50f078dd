#pragma once

#include <atomic>
#include <cstdint>
#include <string>
#include <vector>

#include "messagebus/service/SubscriberCallbackInfo.h"

namespace Korvane::Veldra::MessageBus {

// Erases every correlation callback whose age at nowNs, in whole
// milliseconds, is at least maxAgeMs, and returns the keys it erased. The map
// is locked for one entry at a time, so entries may come and go meanwhile.
std::vector<std::string> PurgeCorrelationCallbacks(CorrIdCallbackMap& callbacks, int64_t nowNs,
                                                   int32_t maxAgeMs);

// Erases every correlation callback whose request has timed out at nowNs
// (ExpiresAt set and reached) and returns the keys it erased.
std::vector<std::string> ExpireCorrelationCallbacks(CorrIdCallbackMap& callbacks, int64_t nowNs);

// Decides when a purge is due: at most once in every period. Safe to ask from
// several threads; exactly one of them gets true for a due period.
class PurgeSchedule {
public:
    PurgeSchedule(int64_t startNs, int32_t periodMs) : Last(startNs), PeriodMs(periodMs) {}

    // True, and the period starts anew at nowNs, when at least PeriodMs
    // milliseconds have passed since the last purge.
    bool Due(int64_t nowNs);

private:
    std::atomic<int64_t> Last;
    const int32_t PeriodMs;
};

}  // namespace Korvane::Veldra::MessageBus
