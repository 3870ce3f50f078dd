#pragma once

#include <memory>

#include "messagebus/amqp/AmqpConnectionManager.h"
#include "messagebus/interfaces/IBroadcastCallback.h"
#include "messagebus/service/MessageService.h"

// What the benchmarks that run a MessageService pair share.
namespace Korvane::Veldra::Bench {

// The settings of a service of this name on its own manager.
inline MessageBus::MessageServiceSettings ServiceSettings(
    MessageBus::AmqpConnectionManager& manager, const char* name) {
    MessageBus::MessageServiceSettings settings;
    settings.Name = name;
    settings.ConnectionManager = &manager;
    return settings;
}

// Answers every message it is given with a GenericResponse.
class AnsweringResponder : public MessageBus::Interfaces::IBroadcastCallback {
public:
    explicit AnsweringResponder(MessageBus::MessageService& service) : service_(service) {}
    void OnMessage(std::shared_ptr<MessageBus::GenericMessage> message) override {
        service_.SendResponse(*message);
    }

private:
    MessageBus::MessageService& service_;
};

}  // namespace Korvane::Veldra::Bench
