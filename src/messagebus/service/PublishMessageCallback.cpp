#include "messagebus/PublishMessageCallback.h"

#include "messagebus/MessagePublisher.h"

namespace Korvane::Veldra::MessageBus {

void PublishMessageCallback::Publish(MessageBase& message, bool mandatory) {
    Publisher->Publish(message, mandatory);
}

}  // namespace Korvane::Veldra::MessageBus
