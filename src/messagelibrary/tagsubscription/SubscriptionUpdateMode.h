#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages {

// How a subscription's updates reach the subscriber: polled, pushed at once,
// or pushed in batches.
enum class SubscriptionUpdateMode : int32_t {
    Poll = 0,
    ImmediateNotification = 1,
    Batch = 2,
};

inline constexpr JsonEnumText kSubscriptionUpdateModeTexts[] = {
    {0, "POLL"}, {1, "IMMEDIATE_NOTIFICATION"}, {2, "BATCH"}};
inline JsonEnumTexts JsonEnumTextsOf(SubscriptionUpdateMode) {
    return kSubscriptionUpdateModeTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagSubscriptionCommunicatorMessages
