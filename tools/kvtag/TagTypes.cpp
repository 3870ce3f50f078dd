#include "TagTypes.h"

#include <array>

namespace kvtag {
namespace {

constexpr std::array<const char*, 6> kNames = {"double", "int32",  "string",
                                               "bool",   "uint64", "datetime"};

}  // namespace

std::optional<int32_t> ParseTypeName(std::string_view name) {
    for (std::size_t code = 0; code < kNames.size(); ++code) {
        if (name == kNames[code]) return static_cast<int32_t>(code);
    }
    return std::nullopt;
}

std::string TypeName(int32_t code) {
    if (code < 0 || code >= static_cast<int32_t>(kNames.size())) return "none";
    return kNames[static_cast<std::size_t>(code)];
}

const char* TypeNameList() {
    return "double, int32, string, bool, uint64, datetime";
}

}  // namespace kvtag
