#include "errors/ErrorCode.h"

namespace Korvane::Veldra::MessageBus {

std::string ErrorCode::FullName() const {
    return category.empty() ? name : category + "." + name;
}

ErrorCode ErrorCode::FromFullName(const std::string& fullName) {
    ErrorCode result;
    const auto dot = fullName.find('.');
    if (dot == std::string::npos) {
        result.name = fullName;
    } else {
        result.category = fullName.substr(0, dot);
        result.name = fullName.substr(dot + 1);
    }
    return result;
}

}  // namespace Korvane::Veldra::MessageBus
