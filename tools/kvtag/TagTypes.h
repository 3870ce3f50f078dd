#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kvtag {

// The data types of the console interface by their codes 0..5; any other
// code is no type.
inline constexpr int32_t kNoType = -1;

// "double", "int32", "string", "bool", "uint64", "datetime" to their codes;
// nothing for any other text (names are matched exactly, in lower case).
std::optional<int32_t> ParseTypeName(std::string_view name);

// The name of a code, "none" for a code outside 0..5.
std::string TypeName(int32_t code);

// The accepted names joined with ", ", for messages and help.
const char* TypeNameList();

}  // namespace kvtag
