#include "messagebus/service/ServiceQueueName.h"

#include "messagelibrary/MessageIdentity.h"

namespace Korvane::Veldra::MessageBus {

std::string NewInstanceId() {
    return NewMessageId().substr(0, 8);
}

std::string ServiceQueueName(const std::string& name, const std::string& instanceId) {
    return instanceId.empty() ? name : name + "_" + instanceId;
}

}  // namespace Korvane::Veldra::MessageBus
