#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

#include "messagelibrary/json/JsonEnum.h"
#include "messagelibrary/json/JsonVariant.h"

namespace Korvane::Veldra::VeldraMessageLibrary {

// The parts of a tag's metadata that a change touches, as a bit set.
enum class TagChangeFlags : int32_t {
    None = 0,
    Keywords = 1,
    Properties = 2,
    CollectAggregates = 4,
};

constexpr TagChangeFlags operator|(TagChangeFlags a, TagChangeFlags b) {
    return static_cast<TagChangeFlags>(static_cast<int32_t>(a) | static_cast<int32_t>(b));
}
constexpr TagChangeFlags operator&(TagChangeFlags a, TagChangeFlags b) {
    return static_cast<TagChangeFlags>(static_cast<int32_t>(a) & static_cast<int32_t>(b));
}

// The names of the single bits, in their written order.
inline constexpr JsonEnumText kTagChangeFlagTexts[] = {
    {1, "KEYWORDS"}, {2, "PROPERTIES"}, {4, "COLLECT_AGGREGATES"}};
inline JsonEnumTexts JsonEnumTextsOf(TagChangeFlags) {
    return kTagChangeFlagTexts;
}

// The list form of a bit set: the names of its known bits separated by ", ",
// as in ["KEYWORDS", "PROPERTIES"]. Not set gives null, 0 gives [], and a
// set with bits but none of them known gives null.
std::string TagChangeFlagsJson(const std::optional<TagChangeFlags>& flags);

// Reads the list form of the member key of object: absent or null is not
// set, an array is the union of its elements, each a name or a number as an
// enumeration reads it. False when the member or an element is refused.
bool ReadTagChangeFlags(std::optional<TagChangeFlags>& out, const JsonVariant& object,
                        std::string_view key);

}  // namespace Korvane::Veldra::VeldraMessageLibrary
