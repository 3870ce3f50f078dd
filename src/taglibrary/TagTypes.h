#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "messagelibrary/TagDataType.h"

namespace Korvane::Veldra::TagLibrary {

using VeldraMessageLibrary::TagDataType;

// Conversions between the three numberings of a tag's data type. The exported
// number, which both function families take and give, is one lower than the
// number in messages: 0 Double ... 5 DateTime.

// 0 to 5 give Double to DateTime; any other number gives a present None.
std::optional<TagDataType> ExportedToType(int32_t exported);
// Double to DateTime give 0 to 5; anything else gives -1.
int32_t TypeToExported(std::optional<TagDataType> type);
// 1 to 6 give the type; anything else gives a present None.
std::optional<TagDataType> MessageValueToType(int32_t value);
// The type field of a received record as the client takes it: a missing or
// null field, like a number out of range, is a present None.
std::optional<TagDataType> MessageValueToType(const std::optional<TagDataType>& field);
// "Double", "Int", "String", "Boolean"; every other value, absent included,
// reads "none". Used only for the inserts of the conflicting-types error.
std::string TypeShortName(std::optional<TagDataType> type);

}  // namespace Korvane::Veldra::TagLibrary
