#pragma once

#include <functional>
#include <memory>
#include <utility>

#include "messagebus/interfaces/IBroadcastCallback.h"

namespace Korvane::Veldra::MessageBus::Interfaces {

// A broadcast callback that hands each message to a function: for handlers
// that are a lambda or a member function rather than a class of their own.
class FunctionBroadcastCallback : public IBroadcastCallback {
public:
    using Function = std::function<void(const GenericMessage&)>;

    explicit FunctionBroadcastCallback(Function handle) : handle_(std::move(handle)) {}
    void OnMessage(std::shared_ptr<GenericMessage> message) override { handle_(*message); }

private:
    Function handle_;
};

}  // namespace Korvane::Veldra::MessageBus::Interfaces
