#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages {

// The order of the values a historian query returns, by time.
enum class HistorianSortOrder : int32_t {
    Ascending = 0,
    Descending = 1,
};

inline constexpr JsonEnumText kHistorianSortOrderTexts[] = {{0, "ASCENDING"}, {1, "DESCENDING"}};
inline JsonEnumTexts JsonEnumTextsOf(HistorianSortOrder) {
    return kHistorianSortOrderTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary::TagHistorianMessages
