#include "messagelibrary/RoutingKey.h"

namespace Korvane::Veldra::MessageBus {

std::string MakeRoutingKey(const std::string& target, const std::string& messageType) {
    std::string key = "Veldra.";
    if (!target.empty()) key.append(target).append(".");
    key.append(messageType);
    return key;
}

}  // namespace Korvane::Veldra::MessageBus
