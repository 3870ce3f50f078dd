#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>

namespace kvtag {

// The data types of the console interface by their codes 0..5; any other
// code is no type.
inline constexpr int32_t kNoType = -1;

// "double", "int32", "string", "bool", "uint64", "datetime", and the other
// names people write for them ("int", "float", "time", ...), to their codes,
// in any case; nothing for any other text.
std::optional<int32_t> ParseTypeName(std::string_view name);

// The name of a code, "none" for a code outside 0..5.
std::string TypeName(int32_t code);

// The types with their other names, "double (or float, real, number)", one
// after the other with `separator` between, for messages and help.
std::string TypeNameList(const char* separator = ", ");

}  // namespace kvtag
