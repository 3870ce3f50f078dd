#include "TagTypes.h"

#include <array>
#include <initializer_list>

namespace kvtag {
namespace {

constexpr std::array<const char*, 6> kNames = {"double", "int32",  "string",
                                               "bool",   "uint64", "datetime"};

// The other names people write for each type, by code.
const std::array<std::initializer_list<const char*>, 6> kAliases = {{
    {"float", "real", "number"},
    {"int", "integer"},
    {"str", "text"},
    {"boolean"},
    {"uint", "unsigned"},
    {"date-time", "time", "timestamp"},
}};

char Lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
}

bool SameIgnoringCase(std::string_view a, std::string_view b) {
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i) {
        if (Lower(a[i]) != Lower(b[i])) return false;
    }
    return true;
}

}  // namespace

std::optional<int32_t> ParseTypeName(std::string_view name) {
    for (std::size_t code = 0; code < kNames.size(); ++code) {
        if (SameIgnoringCase(name, kNames[code])) return static_cast<int32_t>(code);
        for (const char* alias : kAliases[code]) {
            if (SameIgnoringCase(name, alias)) return static_cast<int32_t>(code);
        }
    }
    return std::nullopt;
}

std::string TypeName(int32_t code) {
    if (code < 0 || code >= static_cast<int32_t>(kNames.size())) return "none";
    return kNames[static_cast<std::size_t>(code)];
}

std::string TypeNameList(const char* separator) {
    std::string list;
    for (std::size_t code = 0; code < kNames.size(); ++code) {
        std::string aliases;
        for (const char* alias : kAliases[code]) {
            aliases += (aliases.empty() ? "" : ", ") + std::string(alias);
        }
        list += (code == 0 ? "" : separator) + std::string(kNames[code]) + " (or " + aliases + ")";
    }
    return list;
}

}  // namespace kvtag
