#pragma once

#include <cstdint>

#include "messagelibrary/json/JsonEnum.h"

// The small enumerations of the tag messages besides TagDataType.

namespace Korvane::Veldra::VeldraMessageLibrary {

// A change of a tag's collect-aggregates flag; not set means no change.
enum class CollectAggregatesChange : int32_t {
    None = 0,
    Enable = 1,
    Disable = 2,
};

inline constexpr JsonEnumText kCollectAggregatesChangeTexts[] = {
    {0, "NONE"}, {1, "ENABLE"}, {2, "DISABLE"}};
inline JsonEnumTexts JsonEnumTextsOf(CollectAggregatesChange) {
    return kCollectAggregatesChangeTexts;
}

// How long stored values of a tag are kept.
enum class TagRetentionType : int32_t {
    None = 0,
    Duration = 1,
    Count = 2,
    Permanent = 3,
};

inline constexpr JsonEnumText kTagRetentionTypeTexts[] = {
    {0, "NONE"}, {1, "DURATION"}, {2, "COUNT"}, {3, "PERMANENT"}};
inline JsonEnumTexts JsonEnumTextsOf(TagRetentionType) {
    return kTagRetentionTypeTexts;
}

}  // namespace Korvane::Veldra::VeldraMessageLibrary
