#include "taglibrary/TagTypes.h"

namespace Korvane::Veldra::TagLibrary {

std::optional<TagDataType> ExportedToType(int32_t exported) {
    return MessageValueToType(exported >= 0 && exported <= 5 ? exported + 1 : 0);
}

int32_t TypeToExported(std::optional<TagDataType> type) {
    if (!type) return -1;
    const auto value = static_cast<int32_t>(*type);
    return value >= 1 && value <= 6 ? value - 1 : -1;
}

std::optional<TagDataType> MessageValueToType(int32_t value) {
    if (value >= 1 && value <= 6) return static_cast<TagDataType>(value);
    return TagDataType::None;
}

std::optional<TagDataType> MessageValueToType(const std::optional<TagDataType>& field) {
    return MessageValueToType(field ? static_cast<int32_t>(*field) : 0);
}

std::string TypeShortName(std::optional<TagDataType> type) {
    if (!type) return "none";
    switch (*type) {
        case TagDataType::Double:
            return "Double";
        case TagDataType::Int:
            return "Int";
        case TagDataType::String:
            return "String";
        case TagDataType::Boolean:
            return "Boolean";
        default:
            return "none";
    }
}

}  // namespace Korvane::Veldra::TagLibrary
