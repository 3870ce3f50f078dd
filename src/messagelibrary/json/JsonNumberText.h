#pragma once

#include <cstddef>
#include <cstdint>

// Conversion of number tokens, independent of the process's locale: a
// document is read the same way whatever LC_NUMERIC says.
namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz {

// The token must be a whole number text: "-"? digits ("." digits*)?
// ([eE] [+-]? digits)?, where digits may have leading zeros. "-", "-.5"
// with no integer digit, or an exponent without digits are refused. A value
// beyond the double's range gives an infinity.
bool ConvertJsonDouble(const char* start, std::size_t length, double& out) noexcept;

// Unsigned integers: a token without fraction or exponent is read as digits;
// one with them is converted as a double and must be integral. A negative
// value or one out of range is refused.
bool ConvertJsonUInt64(const char* start, std::size_t length, bool isFloat, uint64_t& out) noexcept;
bool ConvertJsonUInt32(const char* start, std::size_t length, bool isFloat, uint32_t& out) noexcept;

}  // namespace Korvane::Veldra::VeldraMessageLibrary::Jsonz
