#pragma once

#include <string>

namespace Korvane::Veldra::MessageBus {

// A new instance id: the first 8 characters of a random version 4 UUID.
std::string NewInstanceId();

// name + "_" + instanceId, or name alone when the instance id is empty.
std::string ServiceQueueName(const std::string& name, const std::string& instanceId);

}  // namespace Korvane::Veldra::MessageBus
