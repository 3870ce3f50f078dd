#include "messagebus/service/CorrelationPurge.h"

namespace Korvane::Veldra::MessageBus {
namespace {

constexpr int64_t kNsPerMs = 1000000;

int64_t AgeMs(int64_t nowNs, int64_t thenNs) {
    return (nowNs - thenNs) / kNsPerMs;
}

}  // namespace

std::vector<std::string> PurgeCorrelationCallbacks(CorrIdCallbackMap& callbacks, int64_t nowNs,
                                                   int32_t maxAgeMs) {
    std::vector<std::string> purged;
    for (const std::string& key : callbacks.Keys()) {
        // The entry is read again under the lock: it may have fired or been
        // replaced since the keys were copied.
        const bool erased = callbacks.EraseIf(key, [&](const CorrIdCallbackInfo& info) {
            return AgeMs(nowNs, info.CreatedAt) >= maxAgeMs;
        });
        if (erased) purged.push_back(key);
    }
    return purged;
}

std::vector<std::string> ExpireCorrelationCallbacks(CorrIdCallbackMap& callbacks, int64_t nowNs) {
    return callbacks.EraseWhere([nowNs](const std::string&, const CorrIdCallbackInfo& info) {
        return info.ExpiresAt != 0 && info.ExpiresAt <= nowNs;
    });
}

bool PurgeSchedule::Due(int64_t nowNs) {
    int64_t last = Last.load();
    if (AgeMs(nowNs, last) < PeriodMs) return false;
    return Last.compare_exchange_strong(last, nowNs);
}

}  // namespace Korvane::Veldra::MessageBus
