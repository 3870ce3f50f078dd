#include "utilities/managedservice/ManagedServiceCallbacks.h"

#include <utility>

#include "utilities/managedservice/ManagedServiceBase.h"

namespace Korvane::Veldra::VeldraUtilities {

void ReceiveControlMessageCallback::OnMessage(std::shared_ptr<MessageBus::GenericMessage> message) {
    service_->HandleControlMessage(*message);
}

void ReceiveResponseMessageCallback::OnMessage(
    std::shared_ptr<MessageBus::GenericMessage> message) {
    service_->HandleResponseMessage(std::move(message));
}

void ReceiveResponseMessageCallbackWithState::OnResponse(
    std::shared_ptr<MessageBus::GenericMessage> message, uint32_t) {
    service_->HandleResponseMessage(std::move(message));
}

}  // namespace Korvane::Veldra::VeldraUtilities
