#pragma once

#include <cstdint>
#include <memory>

#include "messagebus/interfaces/IBroadcastCallback.h"
#include "messagebus/interfaces/IResponseCallback.h"
#include "messagelibrary/GenericMessage.h"

namespace Korvane::Veldra::VeldraUtilities {

class ManagedServiceBase;

// Every message on the control queue: handed to the service's control
// handling. Runs on the control subscriber's thread.
class ReceiveControlMessageCallback : public MessageBus::Interfaces::IBroadcastCallback {
public:
    explicit ReceiveControlMessageCallback(ManagedServiceBase* service) : service_(service) {}
    void OnMessage(std::shared_ptr<MessageBus::GenericMessage> message) override;
    ~ReceiveControlMessageCallback() override = default;

private:
    ManagedServiceBase* const service_;
};

// What reaches the service's own queue and no one else takes.
class ReceiveResponseMessageCallback : public MessageBus::Interfaces::IBroadcastCallback {
public:
    explicit ReceiveResponseMessageCallback(ManagedServiceBase* service) : service_(service) {}
    void OnMessage(std::shared_ptr<MessageBus::GenericMessage> message) override;
    ~ReceiveResponseMessageCallback() override = default;

private:
    ManagedServiceBase* const service_;
};

// A response to a request the service sent with a non-zero state.
class ReceiveResponseMessageCallbackWithState : public MessageBus::Interfaces::IResponseCallback {
public:
    explicit ReceiveResponseMessageCallbackWithState(ManagedServiceBase* service)
        : service_(service) {}
    void OnResponse(std::shared_ptr<MessageBus::GenericMessage> message, uint32_t state) override;
    ~ReceiveResponseMessageCallbackWithState() override = default;

private:
    ManagedServiceBase* const service_;
};

}  // namespace Korvane::Veldra::VeldraUtilities
