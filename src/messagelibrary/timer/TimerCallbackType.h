#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages {

// Whether a timer calls back once or every time its period elapses.
enum class TimerCallbackType : int32_t {
    Single = 0,
    Repeat = 1,
};

inline constexpr JsonEnumText kTimerCallbackTypeTexts[] = {{0, "SINGLE"}, {1, "REPEAT"}};
inline JsonEnumTexts JsonEnumTextsOf(TimerCallbackType) {
    return kTimerCallbackTypeTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TimerMessages
