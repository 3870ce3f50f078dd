#pragma once

#include <optional>
#include <string>

#include "messagelibrary/TagDataType.h"
#include "messagelibrary/TagRecords.h"

namespace Korvane::Veldra::TagService {

using VeldraMessageLibrary::TagAggregates;
using VeldraMessageLibrary::TagDataType;

// True when a tag of the type can read the text: Double and Int as the
// value rules parse them ("" reads NaN and 0), Boolean one of "true", "True",
// "TRUE", "1", "false", "False", "FALSE", "0" or "", UInt64 plain decimal
// digits within 64 bits, DateTime a timestamp text, String anything. No
// type reads a text with a zero byte, which a body could not carry back. A
// tag of type None reads nothing.
bool CanReadValue(TagDataType type, const std::string& text);

// True for the types whose aggregates are kept: Double, Int and UInt64.
bool IsNumericType(TagDataType type);

// Adds a value that CanReadValue accepted to the aggregates of a numeric tag:
// count and running average, and min and max as value texts of the type.
// Values that are not finite numbers (NaN, infinities) are left out, so that
// the average stays a number; so is everything once count is at its maximum.
void AddToAggregates(TagAggregates& aggregates, TagDataType type, const std::string& text);

}  // namespace Korvane::Veldra::TagService
