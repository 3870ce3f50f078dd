#include "messagelibrary/MessageBase.h"

#include <utility>

#include "messagelibrary/RoutingKey.h"

namespace Korvane::Veldra::MessageBus {

MessageBase::MessageBase(const std::string& messageType, const std::string& contentType,
                         const std::string& target) {
    headers_.messageType = messageType;
    headers_.contentType = contentType;
    headers_.routingKey = MakeRoutingKey(target, messageType);
    headers_.EnsureIdentity();
}

MessageBase::MessageBase(MessageHeaders headers) : headers_(std::move(headers)) {}

}  // namespace Korvane::Veldra::MessageBus
