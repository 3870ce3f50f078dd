#include <utility>

#include "messagebus/service/MessageService.h"

namespace Korvane::Veldra::MessageBus {

void MessageService::MessageServiceResponseCallback::OnResponse(
    std::shared_ptr<GenericMessage> message, uint32_t state) {
    Service->RouteResponse(message, state);
}

bool MessageService::MessageServiceResponseCallback::RunsOnReader(
    const std::string& messageType) const {
    return Service->RoutesOnReader(messageType);
}

void MessageService::MessageServiceRegisterBroadcastCallback::RegisterBroadcast(
    const std::string& messageName, std::shared_ptr<Interfaces::IBroadcastCallback> callback) {
    if (messageName.empty()) return;
    // Bound, then registered: a message of that name that arrives in between
    // takes the default path.
    Service->Subscriber()->Bind({messageName});
    Service->Subscriber()->RegisterMessageCallback(messageName, std::move(callback), false);
}

void MessageService::MessageServiceBroadcastCallback::OnMessage(
    std::shared_ptr<GenericMessage> message) {
    Response->OnResponse(std::move(message), 0);
}

}  // namespace Korvane::Veldra::MessageBus
