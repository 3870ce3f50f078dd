#include "messagebus/service/PublishMessageCallback.h"

#include "messagebus/service/MessagePublisher.h"

namespace Korvane::Veldra::MessageBus {

void PublishMessageCallback::Publish(MessageBase& message, bool mandatory) {
    Publisher->Publish(message, mandatory);
}

}  // namespace Korvane::Veldra::MessageBus
