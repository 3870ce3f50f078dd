#pragma once

#include <cstddef>
#include <cstdint>
#include <optional>
#include <string>

#include "kvveldra/WBTypes.h"
#include "messagelibrary/TagRecords.h"
#include "taglibrary/TagTypes.h"
#include "taglibrary/exports/wb/HostTime.h"

// Tag values in the host's forms: variants and 128-bit timestamps.
namespace Korvane::Veldra::TagLibrary {

using VeldraMessageLibrary::TagAggregates;

// The value text of a variant for a tag of `type`: Double through
// FormatDouble, Int in decimal, Boolean "True" or "False", String the text of
// its handle. UInt64 and DateTime go only as text: they, and an unknown type,
// give "Tag.InvalidTagDataType". An element with no data gives the empty text.
// Returns 0 or a status with `text` filled.
int32_t VariantToValueText(WbVariant* variant, std::optional<TagDataType> type, std::string& value,
                           std::string& text);

// The timestamp of element `index`, or not-a-date-time ("no timestamp") when
// the array is shorter or the element is all zero.
Timestamp HostTimestampAt(WBTimestampArrayHandle timestamps, std::size_t index);
Timestamp HostTimestampOrNone(const WBTimestamp& hostTime);

// How an Int reaches a variant: the single read stores it signed, the multi
// read unsigned.
enum class IntVariant { Signed, Unsigned };

// Creates a variant in `slot` and stores the value text in it by type.
// Double, Int, Boolean and String only; any other type gives
// "Tag.InvalidTagDataType" with `text`. The host's own failure status comes
// back without a text.
int32_t ValueTextToVariant(WbVariant** slot, std::optional<TagDataType> type,
                           const std::string& value, IntVariant intVariant, std::string& text);

// Fill the aggregates clusters of the two single reads; 0 or the status of
// a string copy.
int32_t FillHostAggregates(const TagAggregates& aggregates, WBAggregates& cluster);
int32_t FillHostAggregates(const TagAggregates& aggregates, WBAggregates2& cluster);

// The type and value of a read record, when it has a value.
const VeldraMessageLibrary::TagValue* RecordValue(const VeldraMessageLibrary::TagCurrentValue& record);

}  // namespace Korvane::Veldra::TagLibrary
